// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.util.List;
import java.util.regex.Matcher;
import java.util.regex.Pattern;

/** Why a native library cannot be loaded, and what to do, in sentences. */
final class LoadFailures {
    private static final Pattern MISSING =
            Pattern.compile("(\\S+): cannot open shared object file: No such file");

    private LoadFailures() {}

    static UnsatisfiedLinkError because(String sentences, Throwable cause) {
        UnsatisfiedLinkError error = new UnsatisfiedLinkError(sentences);
        error.initCause(cause);
        return error;
    }

    /** Neither java.library.path nor a JAR has the library; there are JARs for those others. */
    static UnsatisfiedLinkError missing(Machine machine, String version, List<String> others) {
        StringBuilder text = new StringBuilder("There is no native library of the player for ");
        text.append(machine.name()).append(". No folder of java.library.path has ");
        text.append(System.mapLibraryName(NativeLibrary.PLAYER)).append(" (");
        text.append(String.join(", ",
                LibraryPath.folders(System.getProperty("java.library.path"))));
        text.append("), and no JAR on the class path or module path has ");
        text.append(NativeBundle.folder(machine)).append(NativeBundle.LIST).append(". ");
        if (!others.isEmpty()) {
            text.append("There are native JARs, but for ").append(String.join(" and ", others));
            text.append(". ");
        }
        text.append("Add the dependency com.quintora.mmp:mediaplayer-orv:");
        text.append(version == null ? "VERSION" : version).append(":").append(machine.name());
        text.append(", or install the Debian package, or build the library with ./orv build and");
        text.append(" start Java with -Djava.library.path=build/lib.");
        return new UnsatisfiedLinkError(text.toString());
    }

    static UnsatisfiedLinkError otherVersion(NativeBundle bundle, String version) {
        return new UnsatisfiedLinkError(
                "The native JAR is version " + bundle.version()
                        + ", but the Java classes are version " + version
                        + ": give both dependencies one version. (" + bundle.place() + ")");
    }

    /**
     * The virtual machine did not load that library, which may be null where no file is known; its
     * message says why, but not what to do. The system is that which it was built on, or null.
     */
    static UnsatisfiedLinkError refused(String file, String system, UnsatisfiedLinkError cause) {
        String message = String.valueOf(cause.getMessage());
        String text = "The native library ";
        if (file != null) {
            text += file + " ";
        }
        if (system != null) {
            text += "was built on " + system + " and ";
        }
        text += "did not load: " + withoutFile(message, file) + ".";
        String advice = advice(message);
        return because(advice.isEmpty() ? text : text + " " + advice, cause);
    }

    /** The machine and the linker may both have put it in front. */
    private static String withoutFile(String message, String file) {
        String rest = message;
        while (rest.startsWith(file + ": ")) {
            rest = rest.substring(file.length() + 2);
        }
        return rest;
    }

    private static String advice(String message) {
        Matcher missing = MISSING.matcher(message);
        if (missing.find()) {
            String library = missing.group(1);
            return "The system library " + library + " is missing; in Debian it is of the package "
                    + DebianPackages.of(library)
                    + ". There, libmpv2 and libcurl3-gnutls bring all that the player needs. Where"
                    + " the system has another version of it, ./orv package maven builds native"
                    + " libraries for that system.";
        }
        if (message.contains("failed to map segment")) {
            return "Its file system does not allow programs (noexec); name a folder on another with"
                    + " -D" + CacheFolder.PROPERTY + "=FOLDER.";
        }
        if (message.contains("' not found (required by")) {
            return "It was built on a newer system than this one; ./orv package maven builds it on"
                    + " this one.";
        }
        if (message.contains("already loaded in another class")) {
            return "Only one class loader of a process can have it: put the player's JARs into one"
                    + " that all of its users share.";
        }
        return "";
    }
}
