// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/RecordText.h>
#include <stdint.h>

// Codecs are four-character codes, first character in the low byte, as in
// 'h' | '2' << 8 | '6' << 16 | '4' << 24; 0 when unknown. They are the
// registered ones of well-known codecs ("hevc", "mp4a", "ac-3", "fLaC", "tx3g"),
// else the first letters of the codec's common name, padded with blanks
// ("s16l" for signed 16-bit little-endian PCM, "srt ").

// Bits of the flag members.
enum : int32_t {
    ORV_TRACK_FLAG_DEFAULT = 1 << 0,
    ORV_TRACK_FLAG_FORCED = 1 << 1,
    ORV_TRACK_FLAG_EXTERNAL = 1 << 2,
    ORV_TRACK_FLAG_SELECTED = 1 << 3,
};

struct VideoCodecInfo {
    int32_t mCodec = 0;
    int32_t mWidth = 0;      // pixels
    int32_t mHeight = 0;     // rows
    int32_t mFrameRate = 0;  // frames per 1000 seconds
    int32_t mBitRate = 0;    // bits per second, 0 when unknown
    int32_t mFlags = 0;
};

// Subtitle tracks have the indices from 0. Indices from
// ORV_CHAPTER_INDEX_BASE up to ORV_DESCRIPTION_INDEX_BASE (see
// orvtarn/MediaDescription.h) address the media's chapter marks, which are
// timed texts too: mCodec is ORV_CHAPTER_CODEC, mTrackId the start in
// milliseconds, mText the title, mFlags the end in milliseconds (-1: unknown).
enum : int32_t {
    ORV_CHAPTER_INDEX_BASE = 0x10000,
    ORV_CHAPTER_CODEC = 'c' | 'h' << 8 | 'a' << 16 | 'p' << 24,
};

struct SubtitleTrackInfo {
    SubtitleTrackInfo() {
        clearText(mText);
        clearText(mLanguage);
    }

    int32_t mTrackId = 0;
    int32_t mCodec = 0;
    // "language;title" in UTF-8, either part possibly empty.
    OrvText mText;
    int32_t mFlags = 0;
    OrvText mLanguage;  // ISO 639 code
};

struct AudioTrackInfo {
    AudioTrackInfo() {
        clearFirstHalf(mTitle);
        clearFirstHalf(mCodecName);
        clearFirstHalf(mChannelLayout);
        clearFirstHalf(mProfile);
        clearFirstHalf(mComment);
        clearFirstHalf(mEncoder);
        clearFirstHalf(mHandler);
        clearText(mLanguage);
    }

    int32_t mCodec = 0;
    int32_t mChannels = 0;
    int32_t mSampleRate = 0;     // Hz
    int32_t mBitRate = 0;        // bits per second, 0 when unknown
    int32_t mBitsPerSample = 0;  // 0 for codecs without a sample width
    int32_t mTrackId = 0;
    OrvWideText mTitle;
    OrvWideText mCodecName;
    OrvWideText mChannelLayout;
    OrvWideText mProfile;
    int32_t mFlags = 0;
    OrvWideText mComment;
    OrvWideText mEncoder;
    OrvWideText mHandler;
    OrvText mLanguage;  // ISO 639 code
};
