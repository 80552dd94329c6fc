// SPDX-License-Identifier: Apache-2.0

/**
 * What the native half knows by this package's name: the attributes of subtitles. A program makes
 * them by {@link com.quintora.SubtitleAttr#builder()} and gives them to {@link
 * com.quintora.mmp.Subtitles#setStyle}; the player itself is in {@link com.quintora.mmp}.
 *
 * <pre>{@code
 * player.subtitles().setStyle(SubtitleAttr.builder()
 *         .textColor(0xFFFFFF00)
 *         .fontSize(40)
 *         .delay(-500)
 *         .build());
 * }</pre>
 *
 * <p>What a builder is not given stays as it is on the screen.
 */
package com.quintora;
