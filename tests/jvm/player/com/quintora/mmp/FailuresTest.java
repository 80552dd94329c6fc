// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertSame;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

class FailuresTest {
    @ParameterizedTest
    @CsvSource(delimiter = '|', value = {
        "Prepare failed.: status=0xFFFFFC14  | -1004",
        "setDataSource failed.: status=0xFFFFFFFE | -2",
        "setDataSource failed.: status=0x80000000 | -2147483648",
        "Prepare failed.: status=0x7 | 7",
        "Prepare failed. | -2147483648",
        "status=0xFFFFFC14 and more | -2147483648"
    })
    void theStatusIsReadFromTheEndOfTheMessage(String message, int status) {
        assertEquals(status, Failures.status(new IOException(message)));
    }

    @Test
    void aMessageThatIsMissingHasNoStatus() {
        assertEquals(MediaException.STATUS_UNKNOWN, Failures.status(new IOException()));
    }

    @ParameterizedTest
    @CsvSource(delimiter = '|', value = {
        "/no/such.mkv | FFFFFFFE | /no/such.mkv: no such file",
        "/ | FFFFFFEA | /: is a directory",
        "'' | FFFFFFEA | the path is empty",
        "the descriptor | FFFFFFEA | the descriptor: is not open, or a value is out of range",
        "/no/such.mkv | FFFFFC14 | /no/such.mkv: cannot be opened or read",
        "http://h/x | FFFFFC14 | http://h/x: the server refused the connection, does not answer"
            + " or has no such media",
        "file:///no/such.mkv | FFFFFC14 | file:///no/such.mkv: no such file",
        "file:/// | FFFFFC14 | file:///: cannot be opened or read",
        "/x | FFFFFC11 | /x: is no media format that is known",
        "/x | FFFFFC0E | /x: has no track that can be played",
        "/x | FFFFFF92 | /x: was not ready in time",
        "/x | FFFFFFED | /x: the engine failed with status -19"
    })
    void aStatusBecomesASentence(String source, String status, String sentence) {
        IOException thrown = new IOException("Prepare failed.: status=0x" + status);
        MediaException told = Failures.explain(source, thrown, null);
        assertEquals(sentence, told.getMessage());
        assertEquals((int) Long.parseLong(status, 16), told.status());
        assertSame(thrown, told.getCause());
    }

    @Test
    void anEmptyFileIsCalledEmpty(@TempDir Path folder) throws IOException {
        Path empty = Files.createFile(folder.resolve("empty.mkv"));
        IOException thrown = new IOException("Prepare failed.: status=0xFFFFFC11");
        MediaException told = Failures.explain(empty.toString(), thrown, null);
        assertEquals(empty + ": the file is empty", told.getMessage());
    }

    @Test
    void whatASourceThrewIsTheCause() {
        IOException thrown = new IOException("Prepare failed.: status=0xFFFFFC14");
        IOException root = new IOException("the tape tore");
        MediaException told = Failures.explain("the stream source", thrown, root);
        assertSame(root, told.getCause());
        assertSame(thrown, told.getSuppressed()[0]);
        assertEquals("the stream source: the source failed: java.io.IOException: the tape tore",
                told.getMessage());
    }
}
