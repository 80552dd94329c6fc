// SPDX-License-Identifier: Apache-2.0
import com.sun.source.tree.AssignmentTree;
import com.sun.source.tree.BlockTree;
import com.sun.source.tree.DoWhileLoopTree;
import com.sun.source.tree.EnhancedForLoopTree;
import com.sun.source.tree.ExpressionStatementTree;
import com.sun.source.tree.ForLoopTree;
import com.sun.source.tree.IfTree;
import com.sun.source.tree.MethodInvocationTree;
import com.sun.source.tree.NewClassTree;
import com.sun.source.tree.StatementTree;
import com.sun.source.tree.SwitchTree;
import com.sun.source.tree.SynchronizedTree;
import com.sun.source.tree.Tree;
import com.sun.source.tree.TryTree;
import com.sun.source.tree.VariableTree;
import com.sun.source.tree.WhileLoopTree;
import com.sun.source.util.TreeScanner;
import java.util.Collections;
import java.util.HashSet;
import java.util.List;
import java.util.Set;
import java.util.regex.Matcher;
import java.util.regex.Pattern;

/** Two neighbouring statements, which are worth changing places when their order may be noticed. */
final class Swap {
    private static final Pattern NAME = Pattern.compile("[A-Za-z_][A-Za-z0-9_]*");
    private static final List<Class<? extends StatementTree>> KINDS = List.of(
            ExpressionStatementTree.class, VariableTree.class, IfTree.class, ForLoopTree.class,
            EnhancedForLoopTree.class, WhileLoopTree.class, DoWhileLoopTree.class,
            SwitchTree.class, SynchronizedTree.class, TryTree.class, BlockTree.class);

    private final Source source;
    private final StatementTree first;
    private final StatementTree second;

    Swap(Source source, StatementTree first, StatementTree second) {
        this.source = source;
        this.first = first;
        this.second = second;
    }

    boolean isWorth() {
        if (!isFit(first) || !isFit(second) || source.of(first).equals(source.of(second))) {
            return false;
        }
        Set<String> shared = names(first);
        shared.retainAll(names(second));
        // What is declared is not there before its declaration.
        if (first instanceof VariableTree declared
                && names(second).contains(declared.getName().toString())) {
            return false;
        }
        boolean bothSilent = !hasCall(first) && !hasCall(second);
        boolean declares = first instanceof VariableTree || second instanceof VariableTree;
        if (bothSilent) {
            return !shared.isEmpty() && !declares;
        }
        if (hasCall(first) && hasCall(second)) {
            return true;
        }
        StatementTree silent = hasCall(first) ? second : first;
        return !(silent instanceof VariableTree) && (!shared.isEmpty() || isAssignment(silent));
    }

    private boolean isFit(StatementTree statement) {
        String text = source.of(statement);
        return KINDS.stream().anyMatch(kind -> kind.isInstance(statement))
                && !text.startsWith("this(") && !text.startsWith("super(");
    }

    private static boolean isAssignment(StatementTree statement) {
        return statement instanceof ExpressionStatementTree expression
                && expression.getExpression() instanceof AssignmentTree;
    }

    /** Without what stands in texts. */
    private Set<String> names(Tree tree) {
        Set<String> names = new HashSet<>();
        Matcher matcher = NAME.matcher(
                source.of(tree).replaceAll("\"(\\\\.|[^\"\\\\])*\"", "\"\""));
        while (matcher.find()) {
            names.add(matcher.group());
        }
        return names;
    }

    private static boolean hasCall(Tree tree) {
        boolean[] found = {false};
        new TreeScanner<Void, Void>() {
            @Override
            public Void visitMethodInvocation(MethodInvocationTree call, Void none) {
                found[0] = true;
                return null;
            }

            @Override
            public Void visitNewClass(NewClassTree creation, Void none) {
                found[0] = true;
                return null;
            }
        }.scan(Collections.singleton(tree), null);
        return found[0];
    }
}
