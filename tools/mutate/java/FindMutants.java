// SPDX-License-Identifier: Apache-2.0
import com.sun.source.tree.CompilationUnitTree;
import com.sun.source.util.JavacTask;
import com.sun.source.util.SourcePositions;
import com.sun.source.util.Trees;
import java.io.IOException;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.Base64;
import java.util.List;
import javax.tools.JavaCompiler;
import javax.tools.StandardJavaFileManager;
import javax.tools.ToolProvider;

/**
 * Finds the mutants of Java sources in the compiler's syntax tree. Prints a line for each, its
 * fields apart by tabs: file, function, operator, first and last byte, first and last line of the
 * function, and in Base64 what the bytes become. With {@code --reach DIR} writes the sources there
 * instead, each method noting that it is called.
 */
final class FindMutants {
    private FindMutants() {}

    public static void main(String[] arguments) throws IOException {
        boolean reach = arguments.length > 1 && arguments[0].equals("--reach");
        List<Path> files = new ArrayList<>();
        for (int i = reach ? 2 : 0; i < arguments.length; i++) {
            files.add(Path.of(arguments[i]));
        }
        JavaCompiler compiler = ToolProvider.getSystemJavaCompiler();
        try (StandardJavaFileManager manager = compiler.getStandardFileManager(
                null, null, StandardCharsets.UTF_8)) {
            JavacTask task = (JavacTask) compiler.getTask(null, manager, null,
                    List.of("-proc:none"), null, manager.getJavaFileObjectsFromPaths(files));
            SourcePositions positions = Trees.instance(task).getSourcePositions();
            for (CompilationUnitTree unit : task.parse()) {
                Source source = new Source(unit, positions);
                if (reach) {
                    writeReach(source, Path.of(arguments[1]));
                } else {
                    print(source);
                }
            }
        }
    }

    private static void print(Source source) {
        MutantScanner scanner = new MutantScanner(source);
        scanner.scan(source.unit, null);
        for (Change change : scanner.changes()) {
            System.out.println(String.join("\t", source.path, change.function(), change.operator(),
                    "" + source.bytes(change.start()), "" + source.bytes(change.end()),
                    "" + change.firstLine(), "" + change.lastLine(),
                    Base64.getEncoder().encodeToString(
                            change.becomes().getBytes(StandardCharsets.UTF_8))));
        }
    }

    private static void writeReach(Source source, Path folder) throws IOException {
        ReachScanner scanner = new ReachScanner(source);
        scanner.scan(source.unit, null);
        Path target = folder.resolve(Path.of(source.path).getRoot()
                .relativize(Path.of(source.path)));
        Files.createDirectories(target.getParent());
        Files.writeString(target, scanner.text());
    }
}
