// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.io.File;
import java.util.ArrayList;
import java.util.List;

/** The folders that Java looks for native libraries in. */
final class LibraryPath {
    private LibraryPath() {}

    /** The folders of a java.library.path as Java reads it: an empty one between others is ".". */
    static List<String> folders(String path) {
        List<String> folders = new ArrayList<>();
        if (path == null || path.isEmpty()) {
            return folders;
        }
        int start = 0;
        for (int end = 0; end <= path.length(); end++) {
            if (end == path.length() || path.charAt(end) == File.pathSeparatorChar) {
                folders.add(start < end ? path.substring(start, end) : ".");
                start = end + 1;
            }
        }
        return folders;
    }

    /** The first file of that name in those folders, which is the one that Java takes; or null. */
    static String find(String path, String fileName) {
        for (String folder : folders(path)) {
            File file = new File(folder, fileName);
            if (file.exists()) {
                return file.getAbsolutePath();
            }
        }
        return null;
    }
}
