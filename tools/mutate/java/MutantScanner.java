// SPDX-License-Identifier: Apache-2.0
import com.sun.source.tree.AnnotationTree;
import com.sun.source.tree.BinaryTree;
import com.sun.source.tree.BlockTree;
import com.sun.source.tree.BreakTree;
import com.sun.source.tree.CaseTree;
import com.sun.source.tree.CompoundAssignmentTree;
import com.sun.source.tree.ConditionalExpressionTree;
import com.sun.source.tree.ContinueTree;
import com.sun.source.tree.DoWhileLoopTree;
import com.sun.source.tree.EnhancedForLoopTree;
import com.sun.source.tree.ExpressionStatementTree;
import com.sun.source.tree.ExpressionTree;
import com.sun.source.tree.ForLoopTree;
import com.sun.source.tree.IfTree;
import com.sun.source.tree.LambdaExpressionTree;
import com.sun.source.tree.LiteralTree;
import com.sun.source.tree.PrimitiveTypeTree;
import com.sun.source.tree.ReturnTree;
import com.sun.source.tree.StatementTree;
import com.sun.source.tree.SwitchTree;
import com.sun.source.tree.SynchronizedTree;
import com.sun.source.tree.Tree;
import com.sun.source.tree.UnaryTree;
import com.sun.source.tree.VariableTree;
import com.sun.source.tree.WhileLoopTree;
import java.util.ArrayDeque;
import java.util.ArrayList;
import java.util.Deque;
import java.util.EnumSet;
import java.util.List;
import java.util.Set;
import java.util.function.Supplier;
import java.util.regex.Matcher;
import java.util.regex.Pattern;
import javax.lang.model.element.Modifier;

/** Collects the changes of one source. */
final class MutantScanner extends MethodScanner {
    private static final Pattern SYMBOL = Pattern.compile("[-+*/%<>=!&|^]+");
    private static final Pattern COMMENT =
            Pattern.compile("//[^\n]*|/\\*.*?\\*/", Pattern.DOTALL);

    private final List<Change> changes = new ArrayList<>();
    private final Deque<Boolean> loops = new ArrayDeque<>(); // or switches, which are false
    private int lambdas;

    MutantScanner(Source source) {
        super(source);
    }

    List<Change> changes() {
        return changes;
    }

    @Override
    public Void visitAnnotation(AnnotationTree tree, Void none) {
        return null;
    }

    // Whoever uses a constant has it compiled in: a change in its own class alone is none.
    @Override
    public Void visitVariable(VariableTree tree, Void none) {
        boolean isInlined = isConstant(tree) && tree.getInitializer() != null
                && !Swap.hasEffect(tree.getInitializer());
        return isInlined ? null : super.visitVariable(tree, none);
    }

    private boolean isConstant(VariableTree tree) {
        Set<Modifier> modifiers = tree.getModifiers().getFlags();
        boolean isSimple = tree.getType() instanceof PrimitiveTypeTree
                || "String".equals(String.valueOf(tree.getType()));
        boolean isFixed = isFieldOfInterface()
                || modifiers.containsAll(EnumSet.of(Modifier.STATIC, Modifier.FINAL));
        return isSimple && isFixed && !modifiers.contains(Modifier.PRIVATE);
    }

    @Override
    public Void visitIf(IfTree tree, Void none) {
        negateInParentheses(tree.getCondition());
        removeBody(tree.getThenStatement());
        removeBody(tree.getElseStatement());
        return super.visitIf(tree, none);
    }

    @Override
    public Void visitConditionalExpression(ConditionalExpressionTree tree, Void none) {
        negate(tree.getCondition());
        return super.visitConditionalExpression(tree, none);
    }

    @Override
    public Void visitWhileLoop(WhileLoopTree tree, Void none) {
        negateInParentheses(tree.getCondition());
        return inside(true, () -> super.visitWhileLoop(tree, none));
    }

    @Override
    public Void visitDoWhileLoop(DoWhileLoopTree tree, Void none) {
        negateInParentheses(tree.getCondition());
        return inside(true, () -> super.visitDoWhileLoop(tree, none));
    }

    @Override
    public Void visitForLoop(ForLoopTree tree, Void none) {
        return inside(true, () -> super.visitForLoop(tree, none));
    }

    @Override
    public Void visitEnhancedForLoop(EnhancedForLoopTree tree, Void none) {
        return inside(true, () -> super.visitEnhancedForLoop(tree, none));
    }

    @Override
    public Void visitSwitch(SwitchTree tree, Void none) {
        return inside(false, () -> super.visitSwitch(tree, none));
    }

    private Void inside(boolean loop, Supplier<Void> rest) {
        loops.push(loop);
        rest.get();
        loops.pop();
        return null;
    }

    @Override
    public Void visitBinary(BinaryTree tree, Void none) {
        boolean joinsText = tree.getKind() == Tree.Kind.PLUS && source.of(tree).contains("\"");
        if (!joinsText) {
            changeSymbol(source.end(tree.getLeftOperand()), source.start(tree.getRightOperand()));
        }
        return super.visitBinary(tree, none);
    }

    @Override
    public Void visitCompoundAssignment(CompoundAssignmentTree tree, Void none) {
        changeSymbol(source.end(tree.getVariable()), source.start(tree.getExpression()));
        return super.visitCompoundAssignment(tree, none);
    }

    @Override
    public Void visitUnary(UnaryTree tree, Void none) {
        switch (tree.getKind()) {
            case PREFIX_INCREMENT, PREFIX_DECREMENT ->
                changeSymbol(source.start(tree), source.start(tree.getExpression()));
            case POSTFIX_INCREMENT, POSTFIX_DECREMENT ->
                changeSymbol(source.end(tree.getExpression()), source.end(tree));
            default -> { }
        }
        return super.visitUnary(tree, none);
    }

    @Override
    public Void visitLiteral(LiteralTree tree, Void none) {
        for (String becomes : Operators.constants(source.of(tree), tree.getValue())) {
            add("constant", source.start(tree), source.end(tree), becomes);
        }
        return null;
    }

    @Override
    public Void visitLambdaExpression(LambdaExpressionTree tree, Void none) {
        lambdas++;
        super.visitLambdaExpression(tree, none);
        lambdas--;
        return null;
    }

    @Override
    public Void visitReturn(ReturnTree tree, Void none) {
        ExpressionTree expression = tree.getExpression();
        // What a lambda returns is not written.
        if (expression != null && lambdas == 0) {
            for (String becomes : Operators.returned(source.of(expression), returnType())) {
                add("return-value", source.start(expression), source.end(expression), becomes);
            }
        }
        return super.visitReturn(tree, none);
    }

    @Override
    public Void visitContinue(ContinueTree tree, Void none) {
        add("break-continue", source.start(tree), source.end(tree), "break;");
        return null;
    }

    @Override
    public Void visitBreak(BreakTree tree, Void none) {
        if (!loops.isEmpty() && loops.peek()) {
            add("break-continue", source.start(tree), source.end(tree), "continue;");
        } else {
            add("remove-statement", source.start(tree), source.end(tree), ";");
        }
        return null;
    }

    @Override
    public Void visitSynchronized(SynchronizedTree tree, Void none) {
        add("drop-lock", source.start(tree), source.start(tree.getBlock()), "");
        return super.visitSynchronized(tree, none);
    }

    @Override
    void enterMethod(int start, String header) {
        int at = header.indexOf("synchronized ");
        if (at >= 0) {
            add("drop-lock", start + at, start + at + "synchronized ".length(), "");
        }
    }

    @Override
    public Void visitBlock(BlockTree tree, Void none) {
        changeStatements(tree.getStatements());
        return super.visitBlock(tree, none);
    }

    @Override
    public Void visitCase(CaseTree tree, Void none) {
        if (tree.getStatements() != null) {
            changeStatements(tree.getStatements());
        }
        return super.visitCase(tree, none);
    }

    private void changeStatements(List<? extends StatementTree> statements) {
        for (int i = 0; i < statements.size(); i++) {
            StatementTree first = statements.get(i);
            if (first instanceof ExpressionStatementTree && source.isThere(first)) {
                remove(first);
            }
            if (i + 1 < statements.size()) {
                swapWhereWorth(first, statements.get(i + 1));
            }
        }
    }

    private void swapWhereWorth(StatementTree first, StatementTree second) {
        boolean isInConstructor = method() != null && method().getReturnType() == null;
        if (!new Swap(source, first, second, isInConstructor).isWorth()) {
            return;
        }
        String between = source.text.substring(source.end(first), source.start(second));
        add("swap-statements", source.start(first), source.end(second),
                source.of(second) + between + source.of(first));
    }

    private void removeBody(StatementTree body) {
        if (body instanceof ExpressionStatementTree) {
            remove(body);
        }
    }

    // Line breaks stay, so that other lines keep their numbers.
    private void remove(StatementTree statement) {
        add("remove-statement", source.start(statement), source.end(statement),
                ";" + source.of(statement).replaceAll("[^\n]", ""));
    }

    private void negateInParentheses(ExpressionTree condition) {
        add("negate-condition", source.start(condition), source.end(condition),
                "(!" + source.of(condition) + ")");
    }

    private void negate(ExpressionTree condition) {
        add("negate-condition", source.start(condition), source.end(condition),
                "!(" + source.of(condition) + ")");
    }

    private void changeSymbol(int start, int end) {
        Matcher comments = COMMENT.matcher(source.text.substring(start, end));
        String between = comments.replaceAll(match -> " ".repeat(match.group().length()));
        Matcher symbol = SYMBOL.matcher(between);
        String[] found = symbol.find() ? Operators.symbol(symbol.group()) : null;
        if (found != null) {
            add(found[0], start + symbol.start(), start + symbol.end(), found[1]);
        }
    }

    private void add(String operator, int start, int end, String becomes) {
        if (start >= 0 && end >= start) {
            changes.add(new Change(function(), operator, start, end, firstLine(), lastLine(),
                    becomes));
        }
    }
}
