// SPDX-License-Identifier: Apache-2.0
import com.sun.source.tree.ClassTree;
import com.sun.source.tree.MethodTree;
import com.sun.source.tree.Tree;
import com.sun.source.util.TreeScanner;
import java.util.ArrayDeque;
import java.util.Deque;
import java.util.Iterator;

/** Knows which method of which class it is in. */
abstract class MethodScanner extends TreeScanner<Void, Void> {
    final Source source;
    private final Deque<ClassTree> classes = new ArrayDeque<>();
    private final Deque<MethodTree> methods = new ArrayDeque<>();

    MethodScanner(Source source) {
        this.source = source;
    }

    @Override
    public final Void visitClass(ClassTree tree, Void none) {
        classes.push(tree);
        super.visitClass(tree, none);
        classes.pop();
        return null;
    }

    @Override
    public final Void visitMethod(MethodTree tree, Void none) {
        if (!source.isThere(tree)) {
            return null; // the compiler's own
        }
        methods.push(tree);
        if (tree.getBody() != null) {
            int start = source.start(tree);
            enterMethod(start, source.text.substring(start, source.start(tree.getBody())));
        }
        super.visitMethod(tree, none);
        methods.pop();
        return null;
    }

    /** What stands in front of the method's body, from that character on. */
    abstract void enterMethod(int start, String header);

    final MethodTree method() {
        return methods.peek();
    }

    /** Whether a variable that is met here is one, which is static and final unsaid. */
    final boolean isFieldOfInterface() {
        return methods.isEmpty() && classes.peek().getKind() == Tree.Kind.INTERFACE;
    }

    final String returnType() {
        Tree type = methods.isEmpty() ? null : methods.peek().getReturnType();
        return type == null ? "void" : type.toString();
    }

    final String function() {
        StringBuilder name = new StringBuilder();
        for (Iterator<ClassTree> outer = classes.descendingIterator(); outer.hasNext();) {
            name.append(name.isEmpty() ? "" : ".").append(outer.next().getSimpleName());
        }
        String method = methods.isEmpty() ? "" : "." + methods.peek().getName();
        return name + method;
    }

    final int firstLine() {
        return source.line(source.start(enclosing()));
    }

    final int lastLine() {
        return source.line(source.end(enclosing()) - 1);
    }

    private Tree enclosing() {
        return methods.isEmpty() ? classes.peek() : methods.peek();
    }
}
