// SPDX-License-Identifier: Apache-2.0
#include "CoreCalls.h"

#include <dlfcn.h>
#include <mpv/client.h>
#include <pthread.h>
#include <string.h>

#include <atomic>

namespace orvtest {
namespace {

std::atomic<bool> gNoNewCore{false};
std::atomic<const char*> gUnknownOption{nullptr};
std::atomic<int> gQuestions{0};
std::atomic<double> gVolume{-1};
std::atomic<bool> gMute{false};

bool isRendering() {
    char name[16] = "";
    pthread_getname_np(pthread_self(), name, sizeof(name));
    return strcmp(name, "orv-render") == 0;
}

template <class Function>
Function* original(const char* name) {
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

}  // namespace

NoNewCore::NoNewCore() { gNoNewCore = true; }
NoNewCore::~NoNewCore() { gNoNewCore = false; }

UnknownOption::UnknownOption(const char* name) { gUnknownOption = name; }
UnknownOption::~UnknownOption() { gUnknownOption = nullptr; }

int questionsWhileRendering() { return gQuestions; }

double newestVolume() { return gVolume; }
bool newestMute() { return gMute; }

}  // namespace orvtest

// These stand before the media library's for the whole test program.

mpv_handle* mpv_create() {
    static const auto create = orvtest::original<mpv_handle*()>("mpv_create");
    return orvtest::gNoNewCore ? nullptr : create();
}

int mpv_set_option_string(mpv_handle* mpv, const char* name, const char* value) {
    static const auto set =
        orvtest::original<int(mpv_handle*, const char*, const char*)>("mpv_set_option_string");
    const char* unknown = orvtest::gUnknownOption;
    if (unknown != nullptr && strcmp(unknown, name) == 0) return MPV_ERROR_OPTION_NOT_FOUND;
    return set(mpv, name, value);
}

int mpv_set_property(mpv_handle* mpv, const char* name, mpv_format format, void* data) {
    static const auto set =
        orvtest::original<int(mpv_handle*, const char*, mpv_format, void*)>("mpv_set_property");
    if (strcmp(name, "volume") == 0) orvtest::gVolume = *static_cast<double*>(data);
    if (strcmp(name, "mute") == 0) orvtest::gMute = *static_cast<int*>(data) != 0;
    return set(mpv, name, format, data);
}

int mpv_get_property(mpv_handle* mpv, const char* name, mpv_format format, void* data) {
    static const auto get =
        orvtest::original<int(mpv_handle*, const char*, mpv_format, void*)>("mpv_get_property");
    if (orvtest::isRendering()) orvtest::gQuestions++;
    return get(mpv, name, format, data);
}
