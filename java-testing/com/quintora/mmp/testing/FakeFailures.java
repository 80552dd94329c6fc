// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaException;

/** The sentences with which media fail. */
final class FakeFailures {
    private FakeFailures() {}

    static MediaException media(String source, MediaError error) {
        return new MediaException(source + ": " + sentence(source, error), error, null);
    }

    static MediaException subtitles(String source, MediaError error) {
        String sentence = error == MediaError.NOT_FOUND
                ? "no such file"
                : "has no subtitles that can be read";
        return new MediaException(source + ": " + sentence, error, null);
    }

    private static String sentence(String source, MediaError error) {
        return switch (error) {
            case UNKNOWN_HOST -> "the host is not known";
            case CANNOT_CONNECT -> "the server refuses the connection";
            case IO -> "cannot be opened or read";
            case CONNECTION_LOST -> "the connection to the server broke";
            case MALFORMED -> "unknown format";
            case UNSUPPORTED -> "has no track that can be played";
            case SCHEME -> scheme(source);
            case LOCAL_REFERENCE -> "leads to a file of this machine, which it must not open";
            case NO_ANSWER -> "the server does not answer";
            case REDIRECTS -> "the server redirects without end";
            case CERTIFICATE ->
                    "the server's certificate is not trusted; ORV_TLS_VERIFY=no (--insecure)"
                            + " accepts it";
            case CUT_SHORT -> "the server stopped sending before the end that it had announced";
            case NEEDS_RANGES ->
                    "its index is at its end, which takes a server with byte ranges;"
                            + " download it first";
            case EMPTY -> "is empty";
            case NOTHING_INSIDE ->
                    "is a file of a known format in which nothing can be played: it is empty,"
                            + " cut short or damaged";
            case HTTP -> "the server refuses the request";
            case TIMED_OUT -> "was not ready in time";
            case NOT_FOUND -> "no such file";
            case BAD_VALUE -> "is not open, or a value is out of range";
            case ABORTED -> "reset or released while it was being opened";
            case UNKNOWN -> "the engine failed";
        };
    }

    private static String scheme(String source) {
        int end = source.indexOf("://");
        return end < 0
                ? "leads to an address of a kind that is not opened"
                : "addresses that begin with " + source.substring(0, end + 3) + " are not opened";
    }
}
