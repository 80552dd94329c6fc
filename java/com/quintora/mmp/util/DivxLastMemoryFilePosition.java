// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.util;

/**
 * Where a viewer left a DivX medium. The fields are read by the native half, which keeps the low 32
 * bits of each; their meaning is the engine's.
 */
public class DivxLastMemoryFilePosition {
    public long ui8_clip_id;
    public int ui4_title_idx;
    public int ui4_playlist_idx;
    public int ui4_chap_idx;
    public int ui2_aud_idx;
    public int ui2_sub_idx;
    public long ui8_aud_pts_info;
    public long ui8_aud_frame_position;
    public long ui8_i_pts_info;
    public long ui8_pts_info;
    public long ui8_i_frame_position;
    public long ui8_frame_position;
    public int i4_temporal_reference;
    public int ui2_decoding_order;
    public long ui8_stc;
    public long ui8_frame_position_disp;
    public int ui4_timestap;

    /** A position with all values 0. */
    public DivxLastMemoryFilePosition() {}
}
