// SPDX-License-Identifier: Apache-2.0
import com.sun.source.tree.MethodTree;
import com.sun.source.tree.StatementTree;
import java.util.List;
import java.util.TreeMap;

/** Has every method note that it is called. */
final class ReachScanner extends MethodScanner {
    private final TreeMap<Integer, String> insertions = new TreeMap<>();

    ReachScanner(Source source) {
        super(source);
    }

    @Override
    void enterMethod(int start, String header) {
        MethodTree method = method();
        insertions.put(behindCallOfConstructor(method), "OrvReach.note(\"" + source.path + ":"
                + firstLine() + "\");");
    }

    // Nothing may stand in front of it.
    private int behindCallOfConstructor(MethodTree method) {
        List<? extends StatementTree> statements = method.getBody().getStatements();
        if (method.getReturnType() == null && !statements.isEmpty()) {
            String first = source.of(statements.get(0));
            if (first.startsWith("this(") || first.startsWith("super(")) {
                return source.end(statements.get(0));
            }
        }
        return source.start(method.getBody()) + 1;
    }

    /** The source with all of it, on the same lines. */
    String text() {
        StringBuilder text = new StringBuilder(source.text);
        insertions.descendingMap().forEach(text::insert);
        return text.toString().replace("OrvReach.note", "com.quintora.mmp.OrvReach.note");
    }
}
