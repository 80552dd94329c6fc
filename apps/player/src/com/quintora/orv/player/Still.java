// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.awt.image.BufferedImage;

/**
 * A picture of a video.
 *
 * @param timeMs its own time, in milliseconds from the start of the media
 */
public record Still(BufferedImage image, int timeMs) {}
