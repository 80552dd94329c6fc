// SPDX-License-Identifier: Apache-2.0
package android.os;

import static org.junit.jupiter.api.Assertions.assertAll;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

class NativeRegistrationTest {
    static class Base {
        native void inherited();
    }

    static class Sample extends Base {
        native void plain();

        static native void fixed();

        native int wide(long value);

        void written() {}
    }

    private static final String SAMPLE = "android/os/NativeRegistrationTest$Sample";

    @BeforeEach
    void forgetEarlierLines() {
        PlatformNatives.takeLog();
    }

    @Test
    void aClassWithAllMethodsIsRegisteredWithoutAWord() {
        int result = PlatformNatives.registerNatives(
                SAMPLE, new String[] {"plain", "fixed"}, new String[] {"()V", "()V"});
        assertEquals(0, result);
        assertEquals("", PlatformNatives.takeLog());
        new Sample().plain();
        Sample.fixed();
    }

    @Test
    void everyFaultyRowIsNamedWithWhatTheClassHasInstead() {
        String[] names = {"plain", "absent", "wide", "written", "inherited"};
        String[] signatures = {"()V", "(I)Z", "(I)I", "()V", "()V"};
        assertThrows(NoSuchMethodError.class,
                () -> PlatformNatives.registerNatives(SAMPLE, names, signatures));
        String log = PlatformNatives.takeLog();
        String prefix = "AndroidRuntime: " + SAMPLE + ": ";
        assertAll(
                () -> assertTrue(log.startsWith(
                        prefix + "registration of 5 native methods failed\n"), log),
                () -> assertTrue(log.contains(prefix + "no native method absent(I)Z\n"), log),
                () -> assertTrue(log.contains(prefix + "no native method wide(I)I; the class "
                        + "declares native int " + Sample.class.getName() + ".wide(long)\n"), log),
                () -> assertTrue(log.contains(
                        prefix + "method written()V is not declared native: "), log),
                () -> assertTrue(log.contains(
                        prefix + "native method inherited()V is only inherited: "), log),
                () -> assertFalse(log.contains("plain"), log));
    }

    @Test
    void aMissingClassIsNamed() {
        assertThrows(NoClassDefFoundError.class,
                () -> PlatformNatives.registerNatives(
                        "no/such/Player", new String[0], new String[0]));
        assertEquals("AndroidRuntime: no/such/Player: class not found or not initialised, "
                        + "its native methods cannot be registered\n",
                PlatformNatives.takeLog());
    }

    @Test
    void theRuntimeKnowsTheMachineAndTheThread() {
        assertTrue(PlatformNatives.runtimeIsThisMachine());
    }
}
