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
std::atomic<bool> gPause{false};
std::atomic<const char*> gRefusedProperty{nullptr};
std::atomic<const char*> gRefusedCommand{nullptr};

bool isNamed(const std::atomic<const char*>& wanted, const char* name) {
    const char* refused = wanted;
    return refused != nullptr && name != nullptr && strcmp(refused, name) == 0;
}

// The command's name, in a list or under its key.
const char* nameOf(const mpv_node& command) {
    const mpv_node_list& list = *command.u.list;
    for (int i = 0; i < list.num; i++) {
        const bool isName =
            command.format == MPV_FORMAT_NODE_ARRAY ? i == 0 : strcmp(list.keys[i], "name") == 0;
        if (isName) return list.values[i].u.string;
    }
    return nullptr;
}

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
bool newestPause() { return gPause; }

RefusedProperty::RefusedProperty(const char* name) { gRefusedProperty = name; }
RefusedProperty::~RefusedProperty() { gRefusedProperty = nullptr; }

RefusedCommand::RefusedCommand(const char* name) { gRefusedCommand = name; }
RefusedCommand::~RefusedCommand() { gRefusedCommand = nullptr; }

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
    if (orvtest::isNamed(orvtest::gRefusedProperty, name)) return MPV_ERROR_PROPERTY_ERROR;
    if (strcmp(name, "pause") == 0) orvtest::gPause = *static_cast<int*>(data) != 0;
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

int mpv_command(mpv_handle* mpv, const char** arguments) {
    static const auto command = orvtest::original<int(mpv_handle*, const char**)>("mpv_command");
    if (orvtest::isNamed(orvtest::gRefusedCommand, arguments[0])) return MPV_ERROR_COMMAND;
    return command(mpv, arguments);
}

int mpv_command_node(mpv_handle* mpv, mpv_node* arguments, mpv_node* result) {
    static const auto command =
        orvtest::original<int(mpv_handle*, mpv_node*, mpv_node*)>("mpv_command_node");
    const char* name = orvtest::nameOf(*arguments);
    if (orvtest::isNamed(orvtest::gRefusedCommand, name)) return MPV_ERROR_COMMAND;
    return command(mpv, arguments, result);
}

int mpv_command_node_async(mpv_handle* mpv, uint64_t reply, mpv_node* arguments) {
    static const auto command =
        orvtest::original<int(mpv_handle*, uint64_t, mpv_node*)>("mpv_command_node_async");
    const char* name = orvtest::nameOf(*arguments);
    if (orvtest::isNamed(orvtest::gRefusedCommand, name)) return MPV_ERROR_COMMAND;
    return command(mpv, reply, arguments);
}
