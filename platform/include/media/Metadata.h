// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stddef.h>
#include <stdint.h>

namespace android {

class Parcel;

namespace media {

// Writes metadata records into a parcel. Format, all 32-bit words in native
// byte order: total length in bytes from the header's start, the marker
// 'M' 'E' 'T' 'A', then records of {record length, key, type, value}. Types: 1
// is a UTF-16 text, 2 an integer, 3 a flag. Texts are written by their owners.
class Metadata {
public:
    typedef int32_t Type;

    // Keys of the platform's player metadata.
    static constexpr Type kAny = 0;
    static constexpr Type kPauseAvailable = 1;
    static constexpr Type kSeekBackwardAvailable = 2;
    static constexpr Type kSeekForwardAvailable = 3;
    static constexpr Type kSeekAvailable = 4;
    static constexpr Type kTitle = 5;
    static constexpr Type kComment = 6;
    static constexpr Type kCopyright = 7;
    static constexpr Type kAlbum = 8;
    static constexpr Type kArtist = 9;
    static constexpr Type kAuthor = 10;
    static constexpr Type kComposer = 11;
    static constexpr Type kGenre = 12;
    static constexpr Type kDate = 13;
    static constexpr Type kDuration = 14;
    static constexpr Type kCdTrackNum = 15;
    static constexpr Type kCdTrackMax = 16;
    static constexpr Type kRating = 17;
    static constexpr Type kAlbumArt = 18;
    static constexpr Type kVideoFrame = 19;
    static constexpr Type kBitRate = 20;
    static constexpr Type kAudioBitRate = 21;
    static constexpr Type kVideoBitRate = 22;
    static constexpr Type kAudioSampleRate = 23;
    static constexpr Type kVideoframeRate = 24;
    static constexpr Type kMimeType = 25;
    static constexpr Type kAudioCodec = 26;
    static constexpr Type kVideoCodec = 27;
    static constexpr Type kVideoHeight = 28;
    static constexpr Type kVideoWidth = 29;
    static constexpr Type kNumTracks = 30;
    static constexpr Type kDrmCrippled = 31;

    // Starts at the parcel's current position; the parcel must outlive this.
    explicit Metadata(Parcel* parcel);

    // Writes the header with a length of 0. False when the parcel refuses.
    bool appendHeader();
    // Writes the length of all that was appended into the header.
    void updateLength();

    bool appendBool(Type key, bool value);
    bool appendInt32(Type key, int32_t value);

    // Drops the header and everything written after it.
    void resetParcel();

private:
    Metadata(const Metadata&) = delete;
    Metadata& operator=(const Metadata&) = delete;

    Parcel* const mData;
    const size_t mBegin;
};

}  // namespace media
}  // namespace android
