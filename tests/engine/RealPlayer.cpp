// SPDX-License-Identifier: Apache-2.0
#include "RealPlayer.h"

#include <clocale>

namespace orvtest {
namespace {

// Not the end of the file before.
bool isFailure(const mpv_event& event) {
    return event.event_id == MPV_EVENT_END_FILE &&
           static_cast<mpv_event_end_file*>(event.data)->reason == MPV_END_FILE_REASON_ERROR;
}

}  // namespace

RealPlayer::RealPlayer() {
    setlocale(LC_NUMERIC, "C");
    mMpv = mpv_create();
    const char* const options[][2] = {
        {"vo", "null"},     {"ao", "null"},           {"idle", "yes"},
        {"pause", "yes"},   {"config", "no"},         {"sub-auto", "no"},
        {"terminal", "no"}, {"cover-art-auto", "no"}, {"keep-open", "yes"}};
    for (const auto& option : options) mpv_set_option_string(mMpv, option[0], option[1]);
    mpv_initialize(mMpv);
}

RealPlayer::~RealPlayer() { mpv_terminate_destroy(mMpv); }

bool RealPlayer::load(const std::string& path, const orvtarn::MpvOptions& options) {
    if (orvtarn::loadMedia(mMpv, path, options) < 0) return false;
    for (;;) {
        const mpv_event* event = mpv_wait_event(mMpv, 10);
        if (event->event_id == MPV_EVENT_PLAYBACK_RESTART) return true;
        if (event->event_id == MPV_EVENT_NONE || isFailure(*event)) return false;
    }
}

bool RealPlayer::command(const char* name, const char* first, const char* second) {
    const char* command[] = {name, first, second, nullptr};
    return mpv_command(mMpv, command) >= 0;
}

std::string RealPlayer::text(const std::string& property) {
    char* value = mpv_get_property_string(mMpv, property.c_str());
    std::string text = value == nullptr ? "" : value;
    mpv_free(value);
    return text;
}

mpv_node RealPlayer::trackList() {
    mpv_node node = {};
    mpv_get_property(mMpv, "track-list", MPV_FORMAT_NODE, &node);
    return node;
}

}  // namespace orvtest
