// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.util;

/**
 * Where a viewer left a DivX medium. The fields are read by the native half, which keeps the low 32
 * bits of each; their meaning is the engine's.
 */
public class DivxLastMemoryFilePosition {
    /** The clip. */
    public long ui8_clip_id;

    /** The title. */
    public int ui4_title_idx;

    /** The playlist. */
    public int ui4_playlist_idx;

    /** The chapter. */
    public int ui4_chap_idx;

    /** The sound track. */
    public int ui2_aud_idx;

    /** The subtitle track. */
    public int ui2_sub_idx;

    /** The sound's time. */
    public long ui8_aud_pts_info;

    /** The sound frame's byte position. */
    public long ui8_aud_frame_position;

    /** The key frame's time. */
    public long ui8_i_pts_info;

    /** The frame's time. */
    public long ui8_pts_info;

    /** The key frame's byte position. */
    public long ui8_i_frame_position;

    /** The frame's byte position. */
    public long ui8_frame_position;

    /** The frame's number in the order of showing. */
    public int i4_temporal_reference;

    /** The frame's number in the order of decoding. */
    public int ui2_decoding_order;

    /** The clock. */
    public long ui8_stc;

    /** The shown frame's byte position. */
    public long ui8_frame_position_disp;

    /** The time stamp. */
    public int ui4_timestap;

    /** A position with all values 0. */
    public DivxLastMemoryFilePosition() {}
}
