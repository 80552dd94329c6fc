// SPDX-License-Identifier: Apache-2.0
/**
 * A player that needs neither a native library nor media: the test describes the media, moves the
 * clock and orders the failures.
 */
package com.quintora.mmp.testing;
