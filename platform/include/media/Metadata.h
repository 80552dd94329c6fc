// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stddef.h>
#include <stdint.h>

namespace android {

class Parcel;

namespace media {

// Writes metadata records into a parcel. Format, all 32-bit words in native
// byte order: total length in bytes from the header's start, the marker
// 'M' 'E' 'T' 'A', then records of {record length, key, type, value}.
class Metadata {
public:
    typedef int32_t Type;
    enum ValueType : int32_t {
        STRING_VAL = 1,
        INTEGER_VAL = 2,
        BOOLEAN_VAL = 3,
        LONG_VAL = 4,
        DOUBLE_VAL = 5,
    };

    // Keys of the platform's player metadata.
    static constexpr Type kAny = 0;
    static constexpr Type kTitle = 1;
    static constexpr Type kComment = 2;
    static constexpr Type kCopyright = 3;
    static constexpr Type kAlbum = 4;
    static constexpr Type kArtist = 5;
    static constexpr Type kAuthor = 6;
    static constexpr Type kComposer = 7;
    static constexpr Type kGenre = 8;
    static constexpr Type kDate = 9;
    static constexpr Type kDuration = 10;
    static constexpr Type kCdTrackNumber = 11;
    static constexpr Type kBitRate = 13;
    static constexpr Type kVideoHeight = 23;
    static constexpr Type kVideoWidth = 24;
    static constexpr Type kNumTracks = 25;
    static constexpr Type kPauseAvailable = 29;
    static constexpr Type kSeekBackwardAvailable = 30;
    static constexpr Type kSeekForwardAvailable = 31;
    static constexpr Type kSeekAvailable = 32;

    // Starts at the parcel's current position; the parcel must outlive this.
    explicit Metadata(Parcel* parcel);

    // Writes the header with a length of 0. False when the parcel refuses.
    bool appendHeader();
    // Writes the length of all that was appended into the header.
    void updateLength();

    bool appendBool(Type key, bool value);
    bool appendInt32(Type key, int32_t value);
    // UTF-8, zero-terminated; written as UTF-16, as the platform's readers expect.
    bool appendString(Type key, const char* utf8);

    // Drops the header and everything written behind it.
    void resetParcel();

private:
    Metadata(const Metadata&) = delete;
    Metadata& operator=(const Metadata&) = delete;

    Parcel* const mData;
    const size_t mBegin;
};

}  // namespace media
}  // namespace android
