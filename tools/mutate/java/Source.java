// SPDX-License-Identifier: Apache-2.0
import com.sun.source.tree.CompilationUnitTree;
import com.sun.source.tree.Tree;
import com.sun.source.util.SourcePositions;
import java.io.IOException;
import java.nio.charset.StandardCharsets;
import java.nio.file.Path;

/** A source file, and where its trees stand in it: characters, from 0. */
final class Source {
    final CompilationUnitTree unit;
    final String path;
    final String text;
    private final SourcePositions positions;

    Source(CompilationUnitTree unit, SourcePositions positions) throws IOException {
        this.unit = unit;
        this.positions = positions;
        path = Path.of(unit.getSourceFile().toUri()).toString();
        text = unit.getSourceFile().getCharContent(true).toString();
    }

    int start(Tree tree) {
        return (int) positions.getStartPosition(unit, tree);
    }

    int end(Tree tree) {
        return (int) positions.getEndPosition(unit, tree);
    }

    /** Empty for what the compiler has added itself. */
    String of(Tree tree) {
        return isThere(tree) ? text.substring(start(tree), end(tree)) : "";
    }

    boolean isThere(Tree tree) {
        return tree != null && start(tree) >= 0 && end(tree) > start(tree);
    }

    int line(int at) {
        return (int) unit.getLineMap().getLineNumber(at);
    }

    int bytes(int at) {
        return text.substring(0, at).getBytes(StandardCharsets.UTF_8).length;
    }
}
