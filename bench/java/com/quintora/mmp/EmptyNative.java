// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/** The cheapest way into native code and back; the benchmarks' program registers it. */
final class EmptyNative {
    native int nothing();
}
