// SPDX-License-Identifier: Apache-2.0

import com.sun.source.util.JavacTask;
import java.io.File;
import java.io.PrintStream;
import java.lang.module.ModuleFinder;
import java.nio.charset.StandardCharsets;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;
import java.util.Locale;
import java.util.Set;
import java.util.TreeSet;
import java.util.function.Function;
import java.util.stream.Collectors;
import java.util.stream.Stream;
import javax.lang.model.element.AnnotationMirror;
import javax.lang.model.element.Element;
import javax.lang.model.element.ElementKind;
import javax.lang.model.element.ExecutableElement;
import javax.lang.model.element.Modifier;
import javax.lang.model.element.ModuleElement;
import javax.lang.model.element.TypeElement;
import javax.lang.model.element.TypeParameterElement;
import javax.lang.model.element.VariableElement;
import javax.lang.model.type.ArrayType;
import javax.lang.model.type.DeclaredType;
import javax.lang.model.type.TypeKind;
import javax.lang.model.type.TypeMirror;
import javax.lang.model.type.TypeVariable;
import javax.lang.model.type.WildcardType;
import javax.lang.model.util.ElementFilter;
import javax.lang.model.util.Elements;
import javax.tools.ToolProvider;

/**
 * JavaApi JAR... -- JAR...: prints what the modules in the first JARs show to everybody, a line for
 * each element, in the same words whatever the JDK. The others are what they need.
 *
 * <p>The compiler reads the JARs, as it does for programs that use them: nothing of them runs, and
 * annotations are seen that are gone at run time. Those inside types, as of an array's elements,
 * are not, as only newer compilers read them from JARs.
 */
final class JavaApi {
    private final Elements elements;
    private final Set<String> lines = new TreeSet<>();

    private JavaApi(Elements elements) {
        this.elements = elements;
    }

    public static void main(String[] args) {
        List<String> jars = new ArrayList<>(Arrays.asList(args));
        List<String> described = moduleNames(jars.subList(0, jars.indexOf("--")));
        jars.remove("--");
        List<String> options = List.of("--release", "17", "-proc:none",
                "--module-path", String.join(File.pathSeparator, jars),
                "--add-modules", String.join(",", described));
        JavacTask task = (JavacTask) ToolProvider.getSystemJavaCompiler()
                .getTask(null, null, null, options, List.of("java.lang.Object"), null);
        JavaApi api = new JavaApi(task.getElements());
        described.forEach(api::describeModule);
        var out = new PrintStream(System.out, true, StandardCharsets.UTF_8);
        api.lines.forEach(line -> out.print(line + "\n"));
    }

    private static List<String> moduleNames(List<String> jars) {
        ModuleFinder finder = ModuleFinder.of(jars.stream().map(Path::of).toArray(Path[]::new));
        return finder.findAll().stream().map(module -> module.descriptor().name()).toList();
    }

    private void describeModule(String name) {
        ModuleElement module = elements.getModuleElement(name);
        for (var required : ElementFilter.requiresIn(module.getDirectives())) {
            if (required.isTransitive()) {
                lines.add("module " + name + " requires " + (required.isStatic() ? "static " : "")
                        + "transitive " + required.getDependency().getQualifiedName());
            }
        }
        for (var exported : ElementFilter.exportsIn(module.getDirectives())) {
            if (exported.getTargetModules() == null) {
                lines.add("module " + name + " exports "
                        + exported.getPackage().getQualifiedName());
                ElementFilter.typesIn(exported.getPackage().getEnclosedElements())
                        .forEach(this::describeType);
            }
        }
    }

    private void describeType(TypeElement type) {
        if (!isShown(type)) {
            return;
        }
        lines.add(type.getQualifiedName() + " = " + marks(type) + kind(type)
                + list("<", type.getTypeParameters(), JavaApi::bounded, ">") + components(type)
                + list(" extends ", superclasses(type), JavaApi::text)
                + list(type.getKind().isInterface() ? " extends " : " implements ",
                        sorted(type.getInterfaces()), text -> text)
                + list(" permits ", sorted(type.getPermittedSubclasses()), text -> text));
        for (Element member : type.getEnclosedElements()) {
            if (member instanceof TypeElement inner) {
                describeType(inner);
            } else if (isShown(member) && member instanceof ExecutableElement method) {
                describeMethod(type, method);
            } else if (isShown(member) && member instanceof VariableElement field) {
                describeField(type, field);
            }
        }
    }

    private void describeMethod(TypeElement type, ExecutableElement method) {
        boolean isConstructor = method.getKind() == ElementKind.CONSTRUCTOR;
        lines.add(type.getQualifiedName() + "." + method.getSimpleName()
                + list("(", parameters(method), text -> text, ")")
                + " = " + marks(method) + (method.isDefault() ? "default " : "")
                + list("<", method.getTypeParameters(), JavaApi::bounded, "> ")
                + (isConstructor ? "constructor" : text(method.getReturnType()))
                + (method.isVarArgs() ? " varargs" : "")
                + list(" throws ", sorted(method.getThrownTypes()), text -> text));
    }

    private void describeField(TypeElement type, VariableElement field) {
        Object value = field.getConstantValue();
        lines.add(type.getQualifiedName() + "." + field.getSimpleName() + " = " + marks(field)
                + (field.getKind() == ElementKind.ENUM_CONSTANT
                        ? "enum constant"
                        : text(field.asType()))
                + (value == null ? "" : " " + elements.getConstantExpression(value)));
    }

    private static boolean isShown(Element element) {
        Set<Modifier> modifiers = element.getModifiers();
        return element.getKind() != ElementKind.RECORD_COMPONENT
                && (modifiers.contains(Modifier.PUBLIC) || modifiers.contains(Modifier.PROTECTED)
                        && !element.getEnclosingElement().getModifiers().contains(Modifier.FINAL));
    }

    /** Annotations and modifiers, each with a space after it. */
    private static String marks(Element element) {
        Stream<String> modifiers = element.getModifiers().stream()
                .filter(modifier -> modifier != Modifier.NATIVE
                        && modifier != Modifier.SYNCHRONIZED && modifier != Modifier.DEFAULT
                        && modifier != Modifier.STRICTFP)
                .sorted()
                .map(Modifier::toString);
        return annotations(element)
                + modifiers.map(word -> word + " ").collect(Collectors.joining());
    }

    private static String annotations(Element element) {
        return element.getAnnotationMirrors().stream()
                .map(AnnotationMirror::getAnnotationType)
                .map(type -> "@" + type.asElement().getSimpleName() + " ")
                .sorted()
                .collect(Collectors.joining());
    }

    private static String kind(TypeElement type) {
        return switch (type.getKind()) {
            case ANNOTATION_TYPE -> "annotation";
            case ENUM -> "enum";
            case INTERFACE -> "interface";
            case RECORD -> "record";
            default -> "class";
        };
    }

    private static String components(TypeElement type) {
        return type.getKind() == ElementKind.RECORD
                ? list("(", type.getRecordComponents(), component ->
                        annotations(component) + text(component.asType()) + " "
                                + component.getSimpleName(), ")")
                : "";
    }

    private static List<TypeMirror> superclasses(TypeElement type) {
        TypeMirror parent = type.getSuperclass();
        return parent.getKind() == TypeKind.NONE || text(parent).equals("java.lang.Object")
                ? List.of()
                : List.of(parent);
    }

    private static List<String> parameters(ExecutableElement method) {
        return method.getParameters().stream()
                .map(parameter -> annotations(parameter) + text(parameter.asType()))
                .toList();
    }

    private static String bounded(TypeParameterElement parameter) {
        List<? extends TypeMirror> bounds = parameter.getBounds().stream()
                .filter(bound -> !text(bound).equals("java.lang.Object"))
                .toList();
        return parameter.getSimpleName() + (bounds.isEmpty() ? "" : " extends ")
                + bounds.stream().map(JavaApi::text).collect(Collectors.joining(" & "));
    }

    private static List<String> sorted(List<? extends TypeMirror> types) {
        return types.stream().map(JavaApi::text).sorted().toList();
    }

    // A type's own text has annotations, or has not, as the JDK's version is.
    private static String text(TypeMirror type) {
        return switch (type.getKind()) {
            case ARRAY -> text(((ArrayType) type).getComponentType()) + "[]";
            case DECLARED -> text((DeclaredType) type);
            case WILDCARD -> "?" + bound(" extends ", ((WildcardType) type).getExtendsBound())
                    + bound(" super ", ((WildcardType) type).getSuperBound());
            case TYPEVAR -> ((TypeVariable) type).asElement()
                    .getSimpleName().toString();
            default -> type.getKind().toString().toLowerCase(Locale.ROOT);
        };
    }

    private static String text(DeclaredType type) {
        TypeElement element = (TypeElement) type.asElement();
        return element.getQualifiedName()
                + list("<", type.getTypeArguments(), JavaApi::text, ">");
    }

    private static String bound(String word, TypeMirror type) {
        return type == null ? "" : word + text(type);
    }

    private static <T> String list(String word, List<T> items, Function<T, String> text) {
        return items.isEmpty() ? "" : list(word, items, text, "");
    }

    /** Between its ends also when it is empty, if it begins with a parenthesis. */
    private static <T> String list(
            String start, List<T> items, Function<T, String> text, String end) {
        return items.isEmpty() && !start.equals("(")
                ? ""
                : items.stream().map(text).collect(Collectors.joining(", ", start, end));
    }
}
