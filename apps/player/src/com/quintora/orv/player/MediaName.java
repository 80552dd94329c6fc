// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.net.URI;
import java.net.URISyntaxException;
import java.nio.file.Path;

/** What people call a media file, by its path or URL. */
final class MediaName {
    private MediaName() {}

    /** The file's name; of a URL the last part of its path, or else its server. */
    static String of(String source) {
        if (StandardInput.isNamed(source)) {
            return "standard input";
        }
        return source.contains("://") ? ofUrl(source) : ofPath(source);
    }

    /** The same without what names the format: "film" of "film.mkv". */
    static String withoutExtension(String source) {
        String name = of(source);
        int dot = name.lastIndexOf('.');
        boolean isServer = source.endsWith("/");
        boolean isExtension =
                !isServer && dot > 0 && name.length() - dot <= 6 && name.indexOf(' ', dot) < 0;
        return isExtension ? name.substring(0, dot) : name;
    }

    private static String ofPath(String path) {
        Path name = Path.of(path).getFileName();
        return name == null ? path : name.toString();
    }

    private static String ofUrl(String url) {
        try {
            URI address = new URI(url);
            String path = address.getPath() == null ? "" : address.getPath();
            String last = path.substring(path.lastIndexOf('/') + 1);
            String server = address.getHost() == null ? url : address.getHost();
            return last.isEmpty() ? server : last;
        } catch (URISyntaxException e) {
            return url;
        }
    }
}
