// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.memory;

import com.quintora.orv.player.Failure;
import java.io.IOException;
import java.io.Reader;
import java.nio.file.AtomicMoveNotSupportedException;
import java.nio.file.Files;
import java.nio.file.NoSuchFileException;
import java.nio.file.Path;
import java.nio.file.StandardCopyOption;
import java.util.Map;
import java.util.Properties;
import java.util.TreeMap;
import java.util.function.Consumer;

/**
 * What the player remembers from one start to the next: names and values in a text file, a line
 * each, as java.util.Properties reads them, in UTF-8. Names that it does not know stay as they are.
 * Thread-safe; several programs may use the same file.
 */
public final class Memory {
    private static final String HEADING =
            "# What the player remembers. It may be changed or deleted while no player runs.\n";

    private final Path file;
    private boolean isBroken;

    private Memory(Path file) {
        this.file = file;
    }

    /** Remembers nothing. */
    public static Memory none() {
        return new Memory(null);
    }

    public static Memory in(Path file) {
        return new Memory(file);
    }

    /** In the user's configuration folder. */
    public static Memory ofUser() {
        String folder = System.getenv("XDG_CONFIG_HOME");
        // Relative paths there are to be ignored.
        Path base =
                folder != null && folder.startsWith("/")
                        ? Path.of(folder)
                        : Path.of(System.getProperty("user.home"), ".config");
        return new Memory(base.resolve("orv").resolve("player.conf"));
    }

    /** Whether nothing is remembered. */
    public boolean isNone() {
        return file == null;
    }

    /** All names and values; none when there is no file, or none that can be read. */
    public synchronized Map<String, String> read() {
        try {
            return load();
        } catch (IOException | IllegalArgumentException e) {
            complain("cannot read '" + file + "': " + e.getMessage());
            return new TreeMap<>();
        }
    }

    private Map<String, String> load() throws IOException {
        Map<String, String> values = new TreeMap<>();
        if (file == null) {
            return values;
        }
        Properties lines = new Properties();
        try (Reader reader = Files.newBufferedReader(file)) {
            lines.load(reader);
        } catch (NoSuchFileException e) {
            return values;
        }
        lines.forEach((name, value) -> values.put((String) name, (String) value));
        return values;
    }

    /**
     * Changes values of the file as it is now; blocks while it is written. A file that cannot be
     * read is left alone.
     */
    public synchronized void update(Consumer<Map<String, String>> change) {
        if (file == null || isBroken) {
            return;
        }
        try {
            Map<String, String> values = load();
            change.accept(values);
            Files.createDirectories(file.getParent());
            write(values);
        } catch (IOException e) {
            complain(Failure.writing(file, e).getMessage());
        } catch (IllegalArgumentException e) {
            complain("cannot read '" + file + "': " + e.getMessage());
        }
    }

    // Nobody ever sees half a file.
    private void write(Map<String, String> values) throws IOException {
        Path next = Files.createTempFile(file.getParent(), ".player", ".conf");
        try {
            StringBuilder text = new StringBuilder(HEADING);
            values.forEach((name, value) -> text.append(line(name, value)));
            Files.writeString(next, text);
            move(next);
        } finally {
            Files.deleteIfExists(next);
        }
    }

    private void move(Path next) throws IOException {
        try {
            Files.move(next, file, StandardCopyOption.ATOMIC_MOVE);
        } catch (AtomicMoveNotSupportedException e) {
            Files.move(next, file, StandardCopyOption.REPLACE_EXISTING);
        }
    }

    private static String line(String name, String value) {
        String escaped =
                value.replace("\\", "\\\\").replace("\n", "\\n").replace("\r", "\\r");
        return name + " = " + (escaped.startsWith(" ") ? "\\" : "") + escaped + "\n";
    }

    // Once: it would not get better.
    private void complain(String sentence) {
        if (!isBroken) {
            System.err.println("orv: " + sentence + "; nothing is remembered");
        }
        isBroken = true;
    }
}
