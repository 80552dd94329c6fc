// SPDX-License-Identifier: Apache-2.0
#include "playback/Parameters.h"

#include <iconv.h>
#include <math.h>
#include <orvtarn/Parameters.h>
#include <utils/String16.h>
#include <utils/String8.h>

#include <string>

#include "base/EngineLog.h"

namespace orvtarn {
namespace {

using android::Parcel;
using android::status_t;

// A number that mpv keeps: its property, the range, and how many of the
// parameter's units are one of the property's.
struct NumberParameter {
    int key;
    const char* property;
    int32_t least;
    int32_t greatest;
    double scale;
};

const NumberParameter kNumbers[] = {
    {ORV_PARAMETER_NETWORK_TIMEOUT, "network-timeout", 1000, 600000, 1000},
    {ORV_PARAMETER_KEEP_ASPECT, "keepaspect", 0, 1, 0},
    {ORV_PARAMETER_SUBTITLES_VISIBLE, "sub-visibility", 0, 1, 0},
    {ORV_PARAMETER_AUDIO_DELAY, "audio-delay", -10000, 10000, 1000},
};

constexpr char kSubtitleEncoding[] = "sub-codepage";

const NumberParameter* numberOf(int key) {
    for (const NumberParameter& number : kNumbers) {
        if (number.key == key) return &number;
    }
    return nullptr;
}

status_t textOf(const Parcel& request, std::string& text) {
    android::String16 wide;
    const status_t status = request.readString16(&wide);
    if (status == android::NO_ERROR) text = android::String8(wide).c_str();
    return status;
}

// mpv takes any name and fails only when it opens a file. An empty one is
// iconv's for the locale's encoding.
bool isEncoding(const std::string& name) {
    if (name.empty()) return false;
    if (name == "auto") return true;
    const iconv_t converter = iconv_open("UTF-8", name.c_str());
    if (converter == reinterpret_cast<iconv_t>(-1)) return false;
    iconv_close(converter);
    return true;
}

}  // namespace

status_t Parameters::set(int key, const Parcel& request) {
    if (key == ORV_PARAMETER_SUBTITLE_ENCODING) return setText(request);
    if (key >= ORV_PARAMETER_ENGINE_NAME && key <= ORV_PARAMETER_FRAMES_DROPPED) {
        return failed(android::INVALID_OPERATION, "setParameter", "the value can only be read");
    }
    if (numberOf(key) == nullptr) return failed(android::BAD_VALUE, "setParameter", "no such key");
    int32_t value = 0;
    const status_t status = request.readInt32(&value);
    if (status != android::NO_ERROR) return failed(status, "setParameter", "no value");
    return setNumber(key, value);
}

status_t Parameters::setNumber(int key, int32_t value) {
    const NumberParameter& number = *numberOf(key);
    if (value < number.least || value > number.greatest) {
        return failed(android::BAD_VALUE, "setParameter", "the value is out of range");
    }
    const int error = number.scale > 0 ? mMpv.set(number.property, value / number.scale)
                                       : mMpv.set(number.property, value != 0);
    if (error >= 0) return android::NO_ERROR;
    return failed(android::UNKNOWN_ERROR, "setParameter", mpv_error_string(error));
}

status_t Parameters::setText(const Parcel& request) {
    std::string text;
    const status_t status = textOf(request, text);
    if (status != android::NO_ERROR) return failed(status, "setParameter", "no value");
    if (!isEncoding(text)) return failed(android::BAD_VALUE, "setParameter", "no such encoding");
    const int error = mMpv.set(kSubtitleEncoding, text);
    if (error >= 0) return android::NO_ERROR;
    return failed(android::UNKNOWN_ERROR, "setParameter", mpv_error_string(error));
}

status_t Parameters::get(int key, Parcel* reply) {
    if (reply == nullptr) return failed(android::BAD_VALUE, "getParameter", "null argument");
    switch (key) {
        case ORV_PARAMETER_ENGINE_NAME:
            return reply->writeString16(
                android::String16(mMpv.getString("mpv-version").value_or("").c_str()));
        case ORV_PARAMETER_FRAMES_DELIVERED:
            return reply->writeInt64(static_cast<int64_t>(mVideo.counters().delivered));
        case ORV_PARAMETER_FRAMES_MISSED:
            return reply->writeInt64(static_cast<int64_t>(mVideo.counters().missed));
        case ORV_PARAMETER_FRAMES_DROPPED:
            return reply->writeInt64(mMpv.getInt("frame-drop-count").value_or(0) +
                                     mMpv.getInt("decoder-frame-drop-count").value_or(0));
        case ORV_PARAMETER_SUBTITLE_ENCODING:
            return reply->writeString16(
                android::String16(mMpv.getString(kSubtitleEncoding).value_or("").c_str()));
        default:
            return getNumber(key, reply);
    }
}

status_t Parameters::getNumber(int key, Parcel* reply) {
    const NumberParameter* number = numberOf(key);
    if (number == nullptr) return failed(android::BAD_VALUE, "getParameter", "no such key");
    if (number->scale <= 0) {
        return reply->writeInt32(mMpv.getFlag(number->property).value_or(false));
    }
    const double value = mMpv.getDouble(number->property).value_or(0) * number->scale;
    return reply->writeInt32(static_cast<int32_t>(lround(value)));
}

status_t Parameters::invoke(const Parcel& request, Parcel* reply) {
    int32_t method = 0;
    const status_t status = request.readInt32(&method);
    if (status != android::NO_ERROR) return failed(status, "invoke", "no method");
    switch (method) {
        case ORV_INVOKE_GET_TRACKS:
            return getTracks(reply);
        case ORV_INVOKE_ADD_SUBTITLES:
            return addSubtitles(request);
        case ORV_INVOKE_SELECT_TRACK:
        case ORV_INVOKE_DESELECT_TRACK:
            return selectOrDeselect(method, request);
        default:
            return failed(android::BAD_VALUE, "invoke", "no such method");
    }
}

status_t Parameters::getTracks(Parcel* reply) {
    TrackTables all;
    if (reply == nullptr) return failed(android::BAD_VALUE, "invoke", "null argument");
    if (!mTracks.tables("invoke", all)) return android::INVALID_OPERATION;
    reply->writeInt32(
        static_cast<int32_t>(all.video.size() + all.audio.size() + all.subtitles.size()));
    const auto write = [reply](int kind, const auto& tracks) {
        for (const auto& track : tracks) {
            reply->writeInt32(kind);
            reply->writeInt32(track.record.mCodec);
            reply->writeInt32(track.record.mFlags);
        }
    };
    write(ORV_TRACK_KIND_VIDEO, all.video);
    write(ORV_TRACK_KIND_AUDIO, all.audio);
    write(ORV_TRACK_KIND_SUBTITLE, all.subtitles);
    return android::NO_ERROR;
}

status_t Parameters::addSubtitles(const Parcel& request) {
    std::string path;
    const status_t status = textOf(request, path);
    if (status != android::NO_ERROR) return failed(status, "invoke", "no path");
    return mSubtitles.add("invoke", path.c_str(), false);
}

status_t Parameters::selectOrDeselect(int method, const Parcel& request) {
    int32_t number = 0;
    const status_t status = request.readInt32(&number);
    if (status != android::NO_ERROR) return failed(status, "invoke", "no track number");
    const status_t open = mState.requireOpen("invoke");
    if (open != android::NO_ERROR) return open;
    const bool done =
        method == ORV_INVOKE_SELECT_TRACK ? mTracks.select(number) : mTracks.deselect(number);
    return done ? android::NO_ERROR : android::BAD_VALUE;
}

}  // namespace orvtarn
