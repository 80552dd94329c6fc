// SPDX-License-Identifier: Apache-2.0
// The engine's records, field by field: the engine is another library, so a
// record that changes here no longer is the one that it fills. All of it is
// checked while this file compiles. No record but the thumbnail request holds
// a pointer, so the others are alike on 32 and 64 bits.

#include <orvtarn/DivxRecords.h>
#include <orvtarn/MetaDataInfo.h>
#include <orvtarn/PcmRecords.h>
#include <orvtarn/PictureRecords.h>
#include <orvtarn/PlayerTypes.h>
#include <orvtarn/StreamTypes.h>
#include <orvtarn/SubtitleRecords.h>
#include <orvtarn/TrackRecords.h>
#include <stddef.h>

#include <type_traits>

namespace {

template <typename T>
constexpr bool kIsWord = sizeof(T) == 4 && alignof(T) == 4;

// Offset, width and signedness of one field.
template <typename Actual, typename Expected>
constexpr bool isField(size_t actualOffset, size_t offset) {
    return actualOffset == offset && std::is_same_v<Actual, Expected>;
}

}  // namespace

#define RECORD(Record, size, alignment)                                                       \
    static_assert(std::is_standard_layout_v<Record> && std::is_trivially_copyable_v<Record>); \
    static_assert(sizeof(Record) == (size) && alignof(Record) == (alignment))
#define FIELD(Record, field, offset, ...) \
    static_assert(isField<decltype(Record::field), __VA_ARGS__>(offsetof(Record, field), offset))

// Tracks.
RECORD(VideoCodecInfo, 24, 4);
FIELD(VideoCodecInfo, mCodec, 0, int32_t);
FIELD(VideoCodecInfo, mWidth, 4, int32_t);
FIELD(VideoCodecInfo, mHeight, 8, int32_t);
FIELD(VideoCodecInfo, mFrameRate, 12, int32_t);
FIELD(VideoCodecInfo, mBitRate, 16, int32_t);
FIELD(VideoCodecInfo, mFlags, 20, int32_t);

RECORD(SubtitleTrackInfo, 268, 4);
FIELD(SubtitleTrackInfo, mTrackId, 0, int32_t);
FIELD(SubtitleTrackInfo, mCodec, 4, int32_t);
FIELD(SubtitleTrackInfo, mText, 8, char[128]);
FIELD(SubtitleTrackInfo, mFlags, 136, int32_t);
FIELD(SubtitleTrackInfo, mLanguage, 140, char[128]);

RECORD(AudioTrackInfo, 1948, 4);
FIELD(AudioTrackInfo, mCodec, 0, int32_t);
FIELD(AudioTrackInfo, mChannels, 4, int32_t);
FIELD(AudioTrackInfo, mSampleRate, 8, int32_t);
FIELD(AudioTrackInfo, mBitRate, 12, int32_t);
FIELD(AudioTrackInfo, mBitsPerSample, 16, int32_t);
FIELD(AudioTrackInfo, mTrackId, 20, int32_t);
FIELD(AudioTrackInfo, mTitle, 24, uint16_t[128]);
FIELD(AudioTrackInfo, mCodecName, 280, uint16_t[128]);
FIELD(AudioTrackInfo, mChannelLayout, 536, uint16_t[128]);
FIELD(AudioTrackInfo, mProfile, 792, uint16_t[128]);
FIELD(AudioTrackInfo, mFlags, 1048, int32_t);
FIELD(AudioTrackInfo, mComment, 1052, uint16_t[128]);
FIELD(AudioTrackInfo, mEncoder, 1308, uint16_t[128]);
FIELD(AudioTrackInfo, mHandler, 1564, uint16_t[128]);
FIELD(AudioTrackInfo, mLanguage, 1820, char[128]);

// Subtitle attributes.
static_assert(kIsWord<E_Subtitle_Attr_Type>);
static_assert(E_SUBTITLE_ATTR_TYPE_TIME_OFFSET == 0 && E_SUBTITLE_ATTR_TYPE_FONT_INFO == 2 &&
              E_SUBTITLE_ATTR_TYPE_BG_COLOR == 3 && E_SUBTITLE_ATTR_TYPE_TEXT_COLOR == 4 &&
              E_SUBTITLE_ATTR_TYPE_EDGE_COLOR == 5 && E_SUBTITLE_ATTR_TYPE_DISPLAY_OFFSET == 8);

RECORD(Subtitle_TimeOffset, 8, 4);
FIELD(Subtitle_TimeOffset, mTimeOffsetType, 0, int32_t);
FIELD(Subtitle_TimeOffset, mOffsetValue, 4, int32_t);

RECORD(Subtitle_FontInfo, 8, 4);
FIELD(Subtitle_FontInfo, mFontSizeType, 0, int32_t);
FIELD(Subtitle_FontInfo, mCustomSize, 4, uint8_t);

RECORD(Subtitle_Color, 4, 1);
FIELD(Subtitle_Color, mA, 0, uint8_t);
FIELD(Subtitle_Color, mR, 1, uint8_t);
FIELD(Subtitle_Color, mG, 2, uint8_t);
FIELD(Subtitle_Color, mB, 3, uint8_t);

// Pictures and metadata. The words of the thumbnail request follow its pointer.
constexpr size_t kPointer = sizeof(void*);
static_assert(sizeof(_Media_Thumbnail_Info_T) == (kPointer == 4 ? 20 : 24));
static_assert(alignof(_Media_Thumbnail_Info_T) == kPointer);
FIELD(_Media_Thumbnail_Info_T, pBuffer, 0, uint8_t*);
FIELD(_Media_Thumbnail_Info_T, u4BufferSize, kPointer, uint32_t);
FIELD(_Media_Thumbnail_Info_T, i4CanvasColormode, kPointer + 4, int32_t);
FIELD(_Media_Thumbnail_Info_T, i4Width, kPointer + 8, int32_t);
FIELD(_Media_Thumbnail_Info_T, i4Height, kPointer + 12, int32_t);

// The bytes follow the count at once.
RECORD(MediaAlbumArt, 4, 4);
FIELD(MediaAlbumArt, mSize, 0, uint32_t);

RECORD(MetaDataInfo, 1820, 4);
FIELD(MetaDataInfo, mDuration, 0, int32_t);
FIELD(MetaDataInfo, mBitRate, 4, int32_t);
FIELD(MetaDataInfo, mYear, 8, int32_t);
FIELD(MetaDataInfo, mDiscNumber, 12, int32_t);
FIELD(MetaDataInfo, mTrackNumber, 16, int32_t);
FIELD(MetaDataInfo, mTrackTotal, 20, int32_t);
FIELD(MetaDataInfo, mTitle, 24, uint16_t[128]);
FIELD(MetaDataInfo, mArtist, 280, uint16_t[128]);
FIELD(MetaDataInfo, mAlbum, 536, uint16_t[128]);
FIELD(MetaDataInfo, mGenre, 792, uint16_t[128]);
FIELD(MetaDataInfo, mChapterCount, 1048, int32_t);
FIELD(MetaDataInfo, mComposer, 1052, uint16_t[128]);
FIELD(MetaDataInfo, mContainer, 1308, uint16_t[128]);
FIELD(MetaDataInfo, mComment, 1564, uint16_t[128]);

// The PCM description. The format is aligned to 8 bytes, also on 32 bits.
static_assert(kIsWord<E_Orv_Media_Type> && kIsWord<E_Orv_Aud_Enc> && kIsWord<E_Orv_Pcm_Type> &&
              kIsWord<E_Orv_Aud_Ch_Num> && kIsWord<E_Orv_Aud_Sample_Rate> &&
              kIsWord<E_Orv_Aud_Bits_Per_Sample>);

RECORD(IORV_PB_CTRL_SET_MEDIA_INFO_T, 56, 8);
FIELD(IORV_PB_CTRL_SET_MEDIA_INFO_T, eMediaType, 0, E_Orv_Media_Type);
FIELD(IORV_PB_CTRL_SET_MEDIA_INFO_T, u4TotalDuration, 4, uint32_t);
FIELD(IORV_PB_CTRL_SET_MEDIA_INFO_T, u8Size, 8, int64_t);
FIELD(IORV_PB_CTRL_SET_MEDIA_INFO_T, fgSynchronized, 16, uint8_t);
static_assert(offsetof(IORV_PB_CTRL_SET_MEDIA_INFO_T, uFormatInfo.tAudioEsInfo.tAudInfo) == 24);

RECORD(ORV_AUD_INFO_T, 28, 4);
FIELD(ORV_AUD_INFO_T, eAudEnc, 0, E_Orv_Aud_Enc);
static_assert(offsetof(ORV_AUD_INFO_T, uAudCodecInfo.t_pcm_info) == 4);

RECORD(ORV_AUD_PCM_INFO_T, 24, 4);
FIELD(ORV_AUD_PCM_INFO_T, e_pcm_type, 0, E_Orv_Pcm_Type);
FIELD(ORV_AUD_PCM_INFO_T, eNumCh, 4, E_Orv_Aud_Ch_Num);
FIELD(ORV_AUD_PCM_INFO_T, eSampleRate, 8, E_Orv_Aud_Sample_Rate);
FIELD(ORV_AUD_PCM_INFO_T, u2BlockAlign, 12, uint16_t);
FIELD(ORV_AUD_PCM_INFO_T, eBitsPerSample, 16, E_Orv_Aud_Bits_Per_Sample);
FIELD(ORV_AUD_PCM_INFO_T, fgBigEndian, 20, uint8_t);

// DivX navigation. Two pairs of records share a shape.
RECORD(DivxTitleInfo, 12, 4);
FIELD(DivxTitleInfo, mTitle, 0, int32_t);
FIELD(DivxTitleInfo, mPlayListCount, 4, int32_t);
FIELD(DivxTitleInfo, mChapterCount, 8, int32_t);
static_assert(std::is_same_v<DivxPositionInfo, DivxTitleInfo>);

RECORD(DivxChapInfo, 16, 4);
FIELD(DivxChapInfo, mTitle, 0, int32_t);
FIELD(DivxChapInfo, mPlayList, 4, int32_t);
FIELD(DivxChapInfo, mChapter, 8, int32_t);
FIELD(DivxChapInfo, mStart, 12, int32_t);
static_assert(std::is_same_v<DivxPlayListInfo, DivxChapInfo>);

RECORD(DivxDisplayInfo, 540, 4);
FIELD(DivxDisplayInfo, mValues, 0, int32_t[6]);
FIELD(DivxDisplayInfo, mText1, 24, uint16_t[128]);
FIELD(DivxDisplayInfo, mValue7, 280, int32_t);
FIELD(DivxDisplayInfo, mText2, 284, uint16_t[128]);

RECORD(DivxLastMemoryFilePosition, 68, 4);
FIELD(DivxLastMemoryFilePosition, ui8_clip_id, 0, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui4_title_idx, 4, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui4_playlist_idx, 8, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui4_chap_idx, 12, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui2_aud_idx, 16, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui2_sub_idx, 20, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui8_aud_pts_info, 24, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui8_aud_frame_position, 28, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui8_i_pts_info, 32, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui8_pts_info, 36, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui8_i_frame_position, 40, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui8_frame_position, 44, uint32_t);
FIELD(DivxLastMemoryFilePosition, i4_temporal_reference, 48, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui2_decoding_order, 52, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui8_stc, 56, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui8_frame_position_disp, 60, uint32_t);
FIELD(DivxLastMemoryFilePosition, ui4_timestap, 64, uint32_t);

// What crosses by value beside the records.
static_assert(kIsWord<E_OrvPlayer_Type> && kIsWord<E_Orv_Player_Role_Type> &&
              kIsWord<E_Orv_Stream_Seek_Type> && kIsWord<E_Orv_Stream_Source_Type>);
static_assert(ORV_STREAM_ERROR_CODE_OK == 0 && ORV_STREAM_ERROR_CODE_NOT_OK == -1 &&
              ORV_STREAM_ERROR_CODE_EOF == -2);
static_assert(E_ORV_STREAM_SOURCE_EXTENDED_SEEK == 3 && E_ORV_PLAYER_TYPE_TARN == 1);
