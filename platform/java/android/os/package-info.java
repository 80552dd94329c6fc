// SPDX-License-Identifier: Apache-2.0
/** Blocks of values for native code, and threads with a queue of work, as on a television. */
package android.os;
