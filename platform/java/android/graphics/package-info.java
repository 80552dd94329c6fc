// SPDX-License-Identifier: Apache-2.0
/** Pictures and the formats of pixels, as on a television. */
package android.graphics;
