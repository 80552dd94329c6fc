// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.failure;

import com.quintora.mmp.MediaError;

/** Sentences for what goes wrong with addresses and servers. */
final class ServerFailures {
    private static final int HTTP_SERVER_ERROR = 500;

    private ServerFailures() {}

    static String sentence(String source, int status) {
        return switch (MediaError.of(status)) {
            case UNKNOWN_HOST -> "the host is not known";
            case CANNOT_CONNECT -> "the server refuses the connection";
            case CONNECTION_LOST -> "the connection to the server broke";
            case SCHEME -> scheme(source);
            case LOCAL_REFERENCE -> "leads to a file of this machine, which it must not open";
            case NO_ANSWER -> "the server does not answer";
            case REDIRECTS -> "the server redirects without end";
            case CERTIFICATE ->
                    "the server's certificate is not trusted; ORV_TLS_VERIFY=no (--insecure)"
                            + " accepts it";
            case CUT_SHORT ->
                    "the server stopped sending before the end that it had announced";
            case NEEDS_RANGES ->
                    "its index is at its end, which takes a server with byte ranges;"
                            + " download it first";
            case HTTP -> answer(MediaError.HTTP.status() - status);
            default -> "the engine failed with status " + status;
        };
    }

    private static String answer(int http) {
        String refusal = switch (http) {
            case 401, 407 -> "the server asks for a login";
            case 403 -> "the server does not allow access";
            case 404 -> "the server has no such media";
            case 410 -> "the server no longer has the media";
            case 429 -> "the server refuses so many requests";
            default -> http >= HTTP_SERVER_ERROR
                    ? "the server failed"
                    : "the server refuses the request";
        };
        return refusal + " (HTTP status " + http + ")";
    }

    private static String scheme(String source) {
        int end = source.indexOf("://");
        return end < 0
                ? "leads to an address of a kind that is not opened"
                : "addresses that begin with " + source.substring(0, end + 3) + " are not opened";
    }
}
