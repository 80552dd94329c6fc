// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;

import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

class MediaErrorTest {
    @ParameterizedTest
    @CsvSource({
        "-1199, UNKNOWN", "-1200, NOTHING_INSIDE", "-1299, NOTHING_INSIDE", "-1300, UNKNOWN",
        "-2000, HTTP", "-2001, UNKNOWN", "-2399, UNKNOWN", "-2400, HTTP", "-2999, HTTP",
        "-3000, UNKNOWN", "-2, NOT_FOUND", "0, UNKNOWN", "-2147483648, UNKNOWN"
    })
    void severalStatusesAreOfOneError(int status, MediaError error) {
        assertEquals(error, MediaError.of(status));
    }
}
