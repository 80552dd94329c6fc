// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.failure;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertSame;

import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaException;
import java.io.IOException;
import org.junit.jupiter.api.Test;
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
        assertEquals(MediaError.UNKNOWN.status(), Failures.status(new IOException()));
    }

    @ParameterizedTest
    @CsvSource(delimiter = '|', value = {
        "/no/such.mkv | FFFFFFFE | /no/such.mkv: no such file",
        "/ | FFFFFFEA | /: is a directory",
        "'' | FFFFFFEA | the path is empty",
        "the descriptor | FFFFFFEA | the descriptor: is not open, or a value is out of range",
        "/no/such.mkv | FFFFFC14 | /no/such.mkv: cannot be opened or read",
        "http://h/x | FFFFFC14 | http://h/x: cannot be opened or read",
        "http://h/x | FFFFFC16 | http://h/x: the host is not known",
        "http://h/x | FFFFFC15 | http://h/x: the server refuses the connection",
        "http://h/x | FFFFFC13 | http://h/x: the connection to the server broke",
        "fd://0 | FFFFFBB3 | fd://0: addresses that begin with fd:// are not opened",
        "/list.m3u | FFFFFBB3 | /list.m3u: leads to an address of a kind that is not opened",
        "http://h/x | FFFFFBB2 | http://h/x: leads to a file of this machine, which it must not"
            + " open",
        "http://h/x | FFFFFBB1 | http://h/x: the server does not answer",
        "http://h/x | FFFFFBB0 | http://h/x: the server redirects without end",
        "https://h/x | FFFFFBAF | https://h/x: the server's certificate is not trusted;"
            + " ORV_TLS_VERIFY=no (--insecure) accepts it",
        "http://h/x | FFFFFBAE | http://h/x: the server stopped sending before the end that it"
            + " had announced",
        "http://h/x | FFFFFBAD | http://h/x: its index is at its end, which takes a server with"
            + " byte ranges; download it first",
        "http://h/x | FFFFFBAC | http://h/x: is empty",
        "http://h/x | FFFFF69F | http://h/x: the server asks for a login (HTTP status 401)",
        "http://h/x | FFFFF69D | http://h/x: the server does not allow access (HTTP status 403)",
        "http://h/x | FFFFF69C | http://h/x: the server has no such media (HTTP status 404)",
        "http://h/x | FFFFF699 | http://h/x: the server asks for a login (HTTP status 407)",
        "http://h/x | FFFFF696 | http://h/x: the server no longer has the media (HTTP status 410)",
        "http://h/x | FFFFF683 | http://h/x: the server refuses so many requests (HTTP status"
            + " 429)",
        "http://h/x | FFFFF68E | http://h/x: the server refuses the request (HTTP status 418)",
        "http://h/x | FFFFF63C | http://h/x: the server failed (HTTP status 500)",
        "/x | FFFFFB4F | /x: is an MP4 file in which nothing can be played: it is empty, cut short"
            + " or damaged",
        "/x | FFFFFB47 | /x: is a WAV file in which nothing can be played: it is empty, cut short"
            + " or damaged",
        "/x | FFFFFB50 | /x: is a file of a known format in which nothing can be played: it is"
            + " empty, cut short or damaged",
        "file:///no/such.mkv | FFFFFC14 | file:///no/such.mkv: no such file",
        "file:/// | FFFFFC14 | file:///: cannot be opened or read",
        "/x | FFFFFC11 | /x: unknown format",
        "/x | FFFFFC0E | /x: has no track that can be played",
        "/x | FFFFFF92 | /x: was not ready in time",
        "/x | FFFFFFED | /x: the engine failed with status -19"
    })
    void aStatusBecomesASentence(String source, String status, String sentence) {
        IOException thrown = new IOException("Prepare failed.: status=0x" + status);
        MediaException explained = Failures.explain(source, thrown, null);
        assertEquals(sentence, explained.getMessage());
        assertEquals((int) Long.parseLong(status, 16), explained.status());
        assertSame(thrown, explained.getCause());
    }

    @Test
    void whatASourceThrewIsTheCause() {
        IOException thrown = new IOException("Prepare failed.: status=0xFFFFFC14");
        IOException root = new IOException("the tape tore");
        MediaException explained = Failures.explain("the stream source", thrown, root);
        assertSame(root, explained.getCause());
        assertSame(thrown, explained.getSuppressed()[0]);
        assertEquals("the stream source: the source failed: java.io.IOException: the tape tore",
                explained.getMessage());
    }
}
