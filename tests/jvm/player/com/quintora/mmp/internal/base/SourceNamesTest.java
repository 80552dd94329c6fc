// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.base;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;

import java.net.URI;
import java.nio.file.Path;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

class SourceNamesTest {
    @ParameterizedTest
    @CsvSource({
        "file:///a/b%20c.mp4, /a/b c.mp4",
        "FILE:///a.mp4, /a.mp4",
        "http://h/b%20c.mp4, http://h/b%20c.mp4",
        "https://h/\u00fc, https://h/%C3%BC"
    })
    void onlyTheUriOfAFileBecomesAPath(URI uri, String name) {
        assertEquals(name, SourceNames.of(uri));
    }

    @Test
    void aPathBecomesAbsolute() {
        Path file = Path.of("a.mp4");
        assertEquals(file.toAbsolutePath().toString(), SourceNames.of(file));
    }

    @Test
    void aUriWithoutASchemeIsRefused() {
        assertEquals("the URI a.mp4 names no scheme", assertThrows(IllegalArgumentException.class,
                () -> SourceNames.of(URI.create("a.mp4"))).getMessage());
    }
}
