// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.io.IOException;
import java.nio.ByteBuffer;
import java.nio.ByteOrder;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.List;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

class LibraryCheckTest {
    private static final Machine HERE = Machine.ofThisVm();
    private static final int X86_64 = 62;
    private static final int X86 = 3;
    private static final int ARM = 40;

    @TempDir Path folder;

    /** The library that the other tests run with. */
    private static Path library() {
        String found = LibraryPath.find(
                System.getProperty("java.library.path"),
                System.mapLibraryName(NativeLibrary.PLAYER));
        assertNotNull(found);
        return Path.of(found);
    }

    /** A copy built, it seems, for another processor; on ARM for one of 32 bits, too. */
    private Path otherArchitecture() throws Exception {
        byte[] bytes = Files.readAllBytes(library());
        ByteBuffer.wrap(bytes).order(ByteOrder.LITTLE_ENDIAN)
                .putShort(18, (short) (HERE.architecture().equals("armhf") ? X86 : ARM));
        return Files.write(folder.resolve("libother.so"), bytes);
    }

    /** A small library of 64 bits with one note. */
    private Path withNote(String owner, String text) throws Exception {
        ByteBuffer file = ByteBuffer.allocate(256).order(ByteOrder.LITTLE_ENDIAN);
        file.put(new byte[] {0x7F, 'E', 'L', 'F', 2, 1, 1});
        file.putShort(18, (short) X86_64).putLong(32, 64).putShort(54, (short) 56);
        file.putShort(56, (short) 1);
        file.putInt(64, 4).putLong(64 + 8, 120).putLong(64 + 32, 136);
        return withNote(file, owner, text);
    }

    /** One of 32 bits, of either byte order. */
    private Path withNarrowNote(ByteOrder order, String text) throws Exception {
        ByteBuffer file = ByteBuffer.allocate(256).order(order);
        int endian = order == ByteOrder.BIG_ENDIAN ? 2 : 1;
        file.put(new byte[] {0x7F, 'E', 'L', 'F', 1, (byte) endian, 1});
        file.putShort(18, (short) ARM).putInt(28, 52).putShort(42, (short) 32);
        file.putShort(44, (short) 1);
        file.putInt(52, 4).putInt(52 + 4, 120).putInt(52 + 16, 136);
        return withNote(file, ElfFile.NOTE_OWNER, text);
    }

    private Path withNote(ByteBuffer file, String owner, String text) throws Exception {
        byte[] name = (owner + "\0").getBytes(StandardCharsets.US_ASCII);
        byte[] version = (text + "\0").getBytes(StandardCharsets.US_ASCII);
        file.position(120);
        file.putInt(name.length).putInt(version.length).putInt(1).put(name);
        file.position((file.position() + 3) & ~3).put(version);
        return Files.write(folder.resolve("libnote.so"), file.array());
    }

    private static String refusal(Path file, Machine machine, String version) {
        return assertThrows(
                        UnsatisfiedLinkError.class,
                        () -> LibraryCheck.check(file.toString(), machine, version))
                .getMessage();
    }

    @Test
    void theBuiltLibraryGoesWithTheseClasses() throws Exception {
        ElfFile built = ElfFile.read(library().toString());
        assertEquals(HERE.architecture(), built.architecture());
        assertNotNull(JavaVersion.read());
        // The ARM library is built as for a television, without a version.
        assertEquals(
                HERE.architecture().equals("armhf") ? null : JavaVersion.read(), built.version());
        LibraryCheck.check(library().toString(), HERE, JavaVersion.read());
    }

    @Test
    void anotherArchitectureIsRefusedWithBothNames() throws Exception {
        String other = HERE.architecture().equals("armhf") ? "x86" : "armhf";
        Path file = otherArchitecture();
        assertEquals(
                file + " is built for " + other + ", but this Java virtual machine is one for "
                        + HERE.architecture()
                        + ": use the library or the Java of the other's architecture.",
                refusal(file, HERE, JavaVersion.read()));
    }

    @Test
    void anotherVersionIsRefusedWithBothNumbers() throws Exception {
        Path file = withNote(ElfFile.NOTE_OWNER, "0.9.1");
        String refusal = refusal(file, new Machine("linux", "x86_64"), "1.0.0");
        assertTrue(refusal.startsWith(
                file + " is version 0.9.1, but the Java classes are version 1.0.0: "), refusal);
    }

    @Test
    void theSameVersionAndNoneAreAccepted() throws Exception {
        Machine machine = new Machine("linux", "x86_64");
        LibraryCheck.check(withNote(ElfFile.NOTE_OWNER, "1.0.0").toString(), machine, "1.0.0");
        LibraryCheck.check(withNote(ElfFile.NOTE_OWNER, "1.0.0").toString(), machine, null);
        Path foreign = withNote("another", "0.1");
        assertNull(ElfFile.read(foreign.toString()).version());
        LibraryCheck.check(foreign.toString(), machine, "1.0.0");
    }

    @Test
    void aLibraryOf32BitsHasItsVersionInEitherByteOrder() throws Exception {
        for (ByteOrder order : List.of(ByteOrder.LITTLE_ENDIAN, ByteOrder.BIG_ENDIAN)) {
            Path file = withNarrowNote(order, "1.0.0");
            assertEquals(new ElfFile("armhf", "1.0.0"), ElfFile.read(file.toString()),
                    order.toString());
        }
    }

    @Test
    void notesThatEndWithinANotesHeadHaveNoVersion() throws Exception {
        for (int length = 0; length < 12; length++) {
            Path file = withNote(ElfFile.NOTE_OWNER, "1.0.0");
            byte[] bytes = Files.readAllBytes(file);
            ByteBuffer.wrap(bytes).order(ByteOrder.LITTLE_ENDIAN).putLong(64 + 32, length);
            assertNull(ElfFile.read(Files.write(file, bytes).toString()).version(),
                    "of " + length + " bytes");
        }
    }

    @Test
    void theArchitectureIsCheckedBeforeTheVersion() throws Exception {
        String refusal = refusal(
                withNote(ElfFile.NOTE_OWNER, "0.9.1"), new Machine("linux", "armhf"), "1.0.0");
        assertTrue(refusal.contains(" is built for x86_64, "), refusal);
    }

    @Test
    void aNoteWithANegativeOrTooLargeSizeHasNoVersion() throws Exception {
        for (int field : new int[] {120, 124}) {
            for (int size : new int[] {-1, Integer.MIN_VALUE, 125, 1000, Integer.MAX_VALUE}) {
                Path file = withNote(ElfFile.NOTE_OWNER, "1.0.0");
                byte[] bytes = Files.readAllBytes(file);
                ByteBuffer.wrap(bytes).order(ByteOrder.LITTLE_ENDIAN).putInt(field, size);
                assertNull(ElfFile.read(Files.write(file, bytes).toString()).version(),
                        "with " + size + " at " + field);
            }
        }
    }

    @Test
    void whatIsNoLibraryIsRefusedInASentence() throws Exception {
        Path text = Files.writeString(folder.resolve("libtext.so"), "version 1\n".repeat(20));
        assertEquals("The native library cannot be used: " + text
                + " is not an ELF file, so not a native library", refusal(text, HERE, null));
        Path empty = Files.createFile(folder.resolve("libempty.so"));
        assertTrue(refusal(empty, HERE, null).contains("is not an ELF file"));
        Path missing = folder.resolve("libmissing.so");
        assertTrue(refusal(missing, HERE, null).contains("libmissing.so"));
    }

    @Test
    void aLibraryCutOffAnywhereIsRefusedOrHasNoVersion() throws Exception {
        byte[] whole = Files.readAllBytes(withNote(ElfFile.NOTE_OWNER, "1.0.0"));
        for (int size = 0; size < whole.length; size++) {
            Path part = Files.write(folder.resolve("libpart.so"), Arrays.copyOf(whole, size));
            String version = null;
            try {
                version = ElfFile.read(part.toString()).version();
            } catch (IOException e) {
                assertTrue(e.getMessage().contains("libpart.so"), e.getMessage());
            }
            assertNull(version, "of " + size + " bytes");
        }
    }
}
