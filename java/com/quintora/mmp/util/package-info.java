// SPDX-License-Identifier: Apache-2.0

/**
 * Values that cross to the native half, which reads their fields by name: so the fields are public
 * and have the names that it knows. Programs rarely set one by hand.
 *
 * <ul>
 *   <li>{@link com.quintora.mmp.util.PcmMediaInfo} describes raw PCM; {@link
 *       com.quintora.mmp.util.PcmMediaInfo#of} makes a complete description, for {@link
 *       com.quintora.mmp.MediaPlayer#setPcmFormat}.
 *   <li>{@link com.quintora.mmp.util.SubtitleAttr} has the groups of attributes that {@link
 *       com.quintora.SubtitleAttr#builder()} fills.
 *   <li>{@link com.quintora.mmp.util.DivxLastMemoryFilePosition} is where a viewer left DivX media,
 *       for {@link com.quintora.mmp.DivxNavigation}.
 *   <li>{@link com.quintora.mmp.util.ThumbnailInfo} is what the native half is asked for a
 *       thumbnail with; programs call {@link com.quintora.mmp.Pictures#thumbnail}.
 * </ul>
 *
 * <p>Objects of these classes may be filled on any thread, by one at a time. A player reads one
 * during the call that it is given to.
 */
package com.quintora.mmp.util;
