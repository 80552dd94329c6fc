// SPDX-License-Identifier: Apache-2.0
/**
 * What the desktop alone has: frames without a copy, of a size that may change, and a view that
 * says what draws on it. A program that shall also run on a television uses {@link android.media}
 * and {@link android.view}.
 */
package com.quintora.mmp.desktop;
