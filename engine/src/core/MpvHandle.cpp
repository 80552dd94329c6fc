// SPDX-License-Identifier: Apache-2.0
#include "core/MpvHandle.h"

#include <locale.h>
#include <string.h>

#include <mutex>
#include <string>

#include "base/EngineLog.h"
#include "base/LibraryVersions.h"
#include "core/AudioOutputs.h"
#include "core/HardwareDecoder.h"
#include "core/MpvValue.h"
#include "source/TlsSettings.h"
#include "source/UrlScheme.h"

namespace orvtarn {
namespace {

constexpr char kDirection[] = "play-direction";
constexpr char kBackward[] = "backward";

struct Option {
    const char* name;
    const char* value;
};

// Without these nothing plays, or not as the contract has it: frames come to
// the engine, and mpv stays when a file ends.
const Option kNeeded[] = {
    {"vo", "libmpv"}, {"idle", "yes"},  {"keep-open", "yes"}, {"keep-open-pause", "no"},
    {"config", "no"}, {"pause", "yes"}, {"sid", "no"},
};

// A library that was built without what these are about plays all the same.
// Nothing comes from beside the media, nothing is drawn but video and subtitles.
const Option kWished[] = {
    {"audio-client-name", "orvtarn"},
    {"terminal", "no"},
    {"osc", "no"},
    {"load-scripts", "no"},
    {"load-auto-profiles", "no"},
    {"load-console", "no"},
    {"load-stats-overlay", "no"},
    {"ytdl", "no"},
    {"osd-level", "0"},
    // Colours are left to the filters, as by software; and what mpv 0.40 does more on
    // Mesa 25 comes out black now and then.
    {"gpu-dumb-mode", "yes"},
    {"audio-display", "no"},
    {"input-default-bindings", "no"},
    {"sub-auto", "no"},
    {"audio-file-auto", "no"},
    {"cover-art-auto", "no"},
    // Rendering waits for a frame's time; the callback comes in time already.
    {"video-timing-offset", "0"},
    // The software renderer does not turn pictures: filters do.
    {"video-rotate", "no"},
    {"sws-allow-zimg", "no"},
    {"sws-scaler", "fast-bilinear"},
    {"sws-fast", "yes"},
    // Brings back the line on screen when a subtitle track is turned on.
    {"demuxer-mkv-subtitle-preroll-secs-index", "60"},
    {"network-timeout", "20"},
    {"ordered-chapters", "no"},
    {"load-unsafe-playlists", "no"},
};

int setOption(mpv_handle* mpv, const char* name, const char* value) {
    const int error = mpv_set_option_string(mpv, name, value);
    const char* former = formerMpvName(name);
    if (error != MPV_ERROR_OPTION_NOT_FOUND || former == nullptr) return error;
    return mpv_set_option_string(mpv, former, value);
}

bool setNeeded(mpv_handle* mpv, const Option& option) {
    const int error = setOption(mpv, option.name, option.value);
    if (error == 0) return true;
    ALOGE("create: mpv refuses %s=%s, which is needed: %s", option.name, option.value,
          mpv_error_string(error));
    return false;
}

void setWished(mpv_handle* mpv, const Option& option) {
    const int error = setOption(mpv, option.name, option.value);
    if (error == 0) return;
    ALOGW("create: mpv refuses %s=%s: %s", option.name, option.value, mpv_error_string(error));
}

// A connection that broke is taken up again, four times in seven seconds.
void setNetwork(mpv_handle* mpv) {
    const std::string protocols = protocolWhitelist(false);
    const std::string streams =
        "reconnect=1,reconnect_delay_max=4,protocol_whitelist=[" + protocols + "]";
    setWished(mpv, {"stream-lavf-o", streams.c_str()});
    setWished(mpv, {"tls-verify", verifiesCertificates() ? "yes" : "no"});
    setWished(mpv, {"tls-ca-file", certificateFile().c_str()});
}

// mpv refuses to start while numbers are written with a decimal comma,
// and looks at the process's locale, not at the thread's. Anybody may have set
// one since the last handle.
mpv_handle* createWithPointInNumbers() {
    static std::mutex mutex;
    std::lock_guard<std::mutex> lock(mutex);
    const char* numbers = setlocale(LC_NUMERIC, nullptr);
    if (numbers == nullptr || strcmp(numbers, "C") != 0) setlocale(LC_NUMERIC, "C");
    return mpv_create();
}

bool setOptions(mpv_handle* mpv) {
    for (const Option& option : kNeeded) {
        if (!setNeeded(mpv, option)) return false;
    }
    for (const Option& option : kWished) setWished(mpv, option);
    setWished(mpv, {"hwdec", hardwareDecoder()});
    setWished(mpv, {"gpu-hwdec-interop", decoderInterop(hardwareDecoder())});
    setWished(mpv, {"ao", audioOutputs().c_str()});
    setNetwork(mpv);
    return true;
}

bool initialize(mpv_handle* mpv) {
    const int error = mpv_initialize(mpv);
    return error == 0 || refused("create", mpv_error_string(error));
}

// A command's node refers to its list, and that to the arguments.
struct SeekCommand {
    SeekCommand(double seconds, const char* flags) {
        arguments[0].format = arguments[2].format = MPV_FORMAT_STRING;
        arguments[0].u.string = const_cast<char*>("seek");
        arguments[1].format = MPV_FORMAT_DOUBLE;
        arguments[1].u.double_ = seconds;
        arguments[2].u.string = const_cast<char*>(flags);
        node.format = MPV_FORMAT_NODE_ARRAY;
        node.u.list = &list;
    }
    SeekCommand(const SeekCommand&) = delete;
    SeekCommand& operator=(const SeekCommand&) = delete;

    mpv_node arguments[3];
    mpv_node_list list = {3, arguments, nullptr};
    mpv_node node;
};

}  // namespace

bool MpvHandle::create() {
    mLog.enter();
    mpv_handle* mpv = createWithPointInNumbers();
    if (mpv == nullptr) {
        mLog.leave();
        return refused(__func__, "no playback core");
    }
    if (setOptions(mpv) && initialize(mpv)) {
        mLog.settle();
        mHandle = mpv;
        return true;
    }
    mpv_terminate_destroy(mpv);
    mLog.leave();
    return false;
}

void MpvHandle::destroy() {
    mpv_handle* mpv = mHandle.exchange(nullptr);
    if (mpv == nullptr) return;
    mpv_terminate_destroy(mpv);
    mLog.leave();
}

int MpvHandle::setProperty(const char* property, mpv_format format, void* value) {
    mpv_handle* mpv = mHandle;
    if (mpv == nullptr) return MPV_ERROR_UNINITIALIZED;
    return mpv_set_property(mpv, property, format, value);
}

bool MpvHandle::getProperty(const char* property, mpv_format format, void* value) const {
    mpv_handle* mpv = mHandle;
    return mpv != nullptr && mpv_get_property(mpv, property, format, value) >= 0;
}

int MpvHandle::set(const char* property, bool value) {
    int flag = value;
    return setProperty(property, MPV_FORMAT_FLAG, &flag);
}

int MpvHandle::set(const char* property, int64_t value) {
    return setProperty(property, MPV_FORMAT_INT64, &value);
}

int MpvHandle::set(const char* property, double value) {
    return setProperty(property, MPV_FORMAT_DOUBLE, &value);
}

int MpvHandle::set(const char* property, const char* value) {
    return setProperty(property, MPV_FORMAT_STRING, &value);
}

int MpvHandle::set(const char* property, MpvNode& value) {
    return setProperty(property, MPV_FORMAT_NODE, value.get());
}

int MpvHandle::set(const char* property, const std::vector<std::string>& values) {
    std::vector<mpv_node> nodes(values.size());
    for (size_t i = 0; i < values.size(); i++) {
        nodes[i].format = MPV_FORMAT_STRING;
        nodes[i].u.string = const_cast<char*>(values[i].c_str());
    }
    mpv_node_list list = {static_cast<int>(nodes.size()), nodes.data(), nullptr};
    mpv_node node;
    node.format = MPV_FORMAT_NODE_ARRAY;
    node.u.list = &list;
    return setProperty(property, MPV_FORMAT_NODE, &node);
}

std::optional<bool> MpvHandle::getFlag(const char* property) const {
    int flag = 0;
    if (!getProperty(property, MPV_FORMAT_FLAG, &flag)) return {};
    return flag != 0;
}

std::optional<int64_t> MpvHandle::getInt(const char* property) const {
    int64_t value = 0;
    if (!getProperty(property, MPV_FORMAT_INT64, &value)) return {};
    return value;
}

std::optional<double> MpvHandle::getDouble(const char* property) const {
    double value = 0;
    if (!getProperty(property, MPV_FORMAT_DOUBLE, &value)) return {};
    return value;
}

std::optional<std::string> MpvHandle::getString(const char* property) const {
    char* value = nullptr;
    if (!getProperty(property, MPV_FORMAT_STRING, &value)) return {};
    std::string copy(value);
    mpv_free(value);
    return copy;
}

bool MpvHandle::getNode(const char* property, MpvNode& node) const {
    return getProperty(property, MPV_FORMAT_NODE, node.get());
}

int MpvHandle::setBackward(bool backward) {
    if (mHandle == nullptr) return MPV_ERROR_UNINITIALIZED;
    // From what mpv keeps of a stream it may find no key frame to play backward from, and
    // then waits for good: it is to read anew.
    set("demuxer-seekable-cache", backward ? "no" : "auto");
    return assign(mHandle, {kDirection, std::string(backward ? kBackward : "forward")});
}

bool MpvHandle::isBackward() const {
    const std::optional<MpvAssignment> now = currentValue(mHandle, kDirection);
    const auto* name = now ? std::get_if<std::string>(&now->value) : nullptr;
    return name != nullptr && *name == kBackward;
}

int MpvHandle::command(std::initializer_list<const char*> arguments) {
    std::vector<const char*> list(arguments);
    list.push_back(nullptr);
    return mpv_command(mHandle, list.data());
}

int MpvHandle::seek(double seconds, const char* flags) {
    SeekCommand command(seconds, flags);
    return mpv_command_node(mHandle, &command.node, nullptr);
}

int MpvHandle::requestSeek(double seconds, const char* flags) {
    SeekCommand command(seconds, flags);
    return mpv_command_node_async(mHandle, 0, &command.node);
}

}  // namespace orvtarn
