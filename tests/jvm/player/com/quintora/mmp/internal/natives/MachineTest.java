// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import static org.junit.jupiter.api.Assertions.assertEquals;

import org.junit.jupiter.api.Test;

class MachineTest {
    @Test
    void javasNamesBecomeThoseOfTheClassifiers() {
        assertEquals("linux-x86_64", Machine.of("Linux", "amd64").name());
        assertEquals("linux-armhf", Machine.of("Linux", "arm").name());
        assertEquals("linux-aarch64", Machine.of("Linux", "aarch64").name());
        assertEquals("linux-x86", Machine.of("Linux", "i386").name());
        assertEquals("windows11-x86_64", Machine.of("Windows 11", "amd64").name());
    }
}
