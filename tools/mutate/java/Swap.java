// SPDX-License-Identifier: Apache-2.0
import com.sun.source.tree.AssignmentTree;
import com.sun.source.tree.BlockTree;
import com.sun.source.tree.CompoundAssignmentTree;
import com.sun.source.tree.DoWhileLoopTree;
import com.sun.source.tree.EnhancedForLoopTree;
import com.sun.source.tree.ExpressionStatementTree;
import com.sun.source.tree.ForLoopTree;
import com.sun.source.tree.IfTree;
import com.sun.source.tree.StatementTree;
import com.sun.source.tree.SwitchTree;
import com.sun.source.tree.SynchronizedTree;
import com.sun.source.tree.Tree;
import com.sun.source.tree.TryTree;
import com.sun.source.tree.UnaryTree;
import com.sun.source.tree.VariableTree;
import com.sun.source.tree.WhileLoopTree;
import com.sun.source.util.TreeScanner;
import java.util.EnumSet;
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

    private static final Pattern GIVES_THIS_AWAY =
            Pattern.compile("\\bthis\\b(?!\\.)|->|::|(?<![.\\w])(?!new\\b)[a-z]\\w*\\(");
    private static final Set<Tree.Kind> EFFECTS = EnumSet.of(
            Tree.Kind.METHOD_INVOCATION, Tree.Kind.NEW_CLASS, Tree.Kind.RETURN, Tree.Kind.THROW,
            Tree.Kind.BREAK, Tree.Kind.CONTINUE);

    private final Source source;
    private final StatementTree first;
    private final StatementTree second;
    private final boolean isInConstructor;

    Swap(Source source, StatementTree first, StatementTree second, boolean isInConstructor) {
        this.source = source;
        this.first = first;
        this.second = second;
        this.isInConstructor = isInConstructor;
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
        if (hasEffect(first) && hasEffect(second) || changesWhatTheOtherUses()) {
            return true;
        }
        if (!hasEffect(first) && !hasEffect(second)) {
            return false;
        }
        StatementTree silent = hasEffect(first) ? second : first;
        StatementTree other = hasEffect(first) ? first : second;
        if (silent instanceof VariableTree || isInConstructor && !mayUseThis(other)) {
            return false;
        }
        return !shared.isEmpty() || target(silent) != null;
    }

    // Nobody else has an object that is being made, unless it is given away.
    private boolean mayUseThis(StatementTree statement) {
        return !(statement instanceof ExpressionStatementTree)
                || GIVES_THIS_AWAY.matcher(source.of(statement)).find();
    }

    private boolean changesWhatTheOtherUses() {
        return isUsed(target(first), second) || isUsed(target(second), first);
    }

    private boolean isUsed(String target, StatementTree statement) {
        return target != null && Pattern.compile("(?<!\\w)" + Pattern.quote(target) + "(?!\\w)")
                .matcher(source.of(statement)).find();
    }

    /** What a statement changes, as it is written; null for those that only call. */
    private String target(StatementTree statement) {
        if (!(statement instanceof ExpressionStatementTree expression)) {
            return null;
        }
        if (expression.getExpression() instanceof AssignmentTree assignment) {
            return source.of(assignment.getVariable());
        }
        if (expression.getExpression() instanceof CompoundAssignmentTree assignment) {
            return source.of(assignment.getVariable());
        }
        return expression.getExpression() instanceof UnaryTree step
                ? source.of(step.getExpression()) : null;
    }

    private boolean isFit(StatementTree statement) {
        String text = source.of(statement);
        return KINDS.stream().anyMatch(kind -> kind.isInstance(statement))
                && !text.startsWith("this(") && !text.startsWith("super(");
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

    /** A call, or a way out. */
    static boolean hasEffect(Tree tree) {
        boolean[] found = {false};
        new TreeScanner<Void, Void>() {
            @Override
            public Void scan(Tree part, Void none) {
                found[0] = found[0] || part != null && EFFECTS.contains(part.getKind());
                return found[0] ? null : super.scan(part, none);
            }
        }.scan(tree, null);
        return found[0];
    }
}
