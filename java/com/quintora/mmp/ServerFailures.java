// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.util.Optional;

/** Sentences for what goes wrong with addresses and servers. */
final class ServerFailures {
    private static final int MIN_HTTP = 400;
    private static final int MAX_HTTP = 999;
    private static final int HTTP_SERVER_ERROR = 500;

    private ServerFailures() {}

    /** Empty for a status that says nothing of a server. */
    static Optional<String> sentence(String source, int status) {
        int http = MediaException.STATUS_HTTP - status;
        if (http >= MIN_HTTP && http <= MAX_HTTP) {
            return Optional.of(answer(http) + " (HTTP status " + http + ")");
        }
        return Optional.ofNullable(switch (status) {
            case MediaException.STATUS_UNKNOWN_HOST -> "the host is not known";
            case MediaException.STATUS_CANNOT_CONNECT -> "the server refuses the connection";
            case MediaException.STATUS_CONNECTION_LOST -> "the connection to the server broke";
            case MediaException.STATUS_SCHEME -> scheme(source);
            case MediaException.STATUS_LOCAL_REFERENCE ->
                    "leads to a file of this machine, which it must not open";
            case MediaException.STATUS_NO_ANSWER -> "the server does not answer";
            case MediaException.STATUS_REDIRECTS -> "the server redirects without end";
            case MediaException.STATUS_CERTIFICATE ->
                    "the server's certificate is not trusted; ORV_TLS_VERIFY=no (--insecure)"
                            + " accepts it";
            case MediaException.STATUS_CUT_SHORT ->
                    "the server stopped sending before the end that it had announced";
            case MediaException.STATUS_NEEDS_RANGES ->
                    "its index is at its end, which takes a server with byte ranges;"
                            + " download it first";
            default -> null;
        });
    }

    private static String answer(int http) {
        return switch (http) {
            case 401, 407 -> "the server asks for a login";
            case 403 -> "the server does not allow access";
            case 404 -> "the server has no such media";
            case 410 -> "the server no longer has the media";
            case 429 -> "the server refuses so many requests";
            default -> http >= HTTP_SERVER_ERROR
                    ? "the server failed"
                    : "the server refuses the request";
        };
    }

    private static String scheme(String source) {
        int end = source.indexOf("://");
        return end < 0
                ? "leads to an address of a kind that is not opened"
                : "addresses that begin with " + source.substring(0, end + 3) + " are not opened";
    }
}
