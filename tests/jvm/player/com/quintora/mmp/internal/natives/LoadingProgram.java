// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import com.quintora.mmp.OrvMediaPlayer;
import java.io.IOException;

/** Loads or unpacks in a process of its own, and prints where or why not. */
final class LoadingProgram {
    private LoadingProgram() {}

    /** With "load" as the player's class does, with "unpack" the native JAR alone. */
    public static void main(String[] arguments) throws IOException {
        System.out.println("ready");
        System.in.read();
        try {
            if (arguments[0].equals("load")) {
                new OrvMediaPlayer().close();
                System.out.println("loaded");
            } else {
                System.out.println(NativeJar.library(arguments[1]));
            }
        } catch (UnsatisfiedLinkError e) {
            System.out.println(e.getMessage());
        }
    }
}
