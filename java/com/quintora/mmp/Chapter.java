// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

/**
 * A chapter mark.
 *
 * @param index its number, from 0
 * @param startMillis where it begins, in milliseconds
 * @param endMillis where it ends, in milliseconds; -1 when unknown
 * @param title its title, possibly empty
 */
public record Chapter(int index, int startMillis, int endMillis, String title) {}
