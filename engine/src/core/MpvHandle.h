// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mpv/client.h>
#include <stdint.h>

#include <atomic>
#include <initializer_list>
#include <optional>
#include <string>
#include <vector>

#include "core/SharedLog.h"

namespace orvtarn {

// A property of mpv as a tree of values.
class MpvNode {
public:
    MpvNode() { mNode.format = MPV_FORMAT_NONE; }
    ~MpvNode() { mpv_free_node_contents(&mNode); }
    MpvNode(const MpvNode&) = delete;
    MpvNode& operator=(const MpvNode&) = delete;

    mpv_node* get() { return &mNode; }
    const mpv_node& operator*() const { return mNode; }

private:
    mpv_node mNode;
};

// One mpv handle, a core of its own. Any thread may use properties and commands while there is
// one; only the event loop waits for events. Results are 0 or an mpv_error. Until there is a core,
// properties have no values and cannot be set: one that is made later has its usual settings.
class MpvHandle {
public:
    // Creates and initialises mpv with the options every player has.
    // False without memory or with a library that refuses a needed one.
    bool create();
    // Ends mpv; its streams are closed and its threads gone afterwards.
    void destroy();
    // Null until there is one.
    mpv_handle* get() const { return mHandle; }
    // Whether what FFmpeg logs is about this handle's media, and about no other's.
    bool ownsLog() const { return mLog.isOwn(); }

    int set(const char* property, bool value);
    int set(const char* property, int64_t value);
    int set(const char* property, double value);
    int set(const char* property, const char* value);
    int set(const char* property, const std::string& value) { return set(property, value.c_str()); }
    // As getNode gave it.
    int set(const char* property, MpvNode& value);
    // A list of texts, which may contain any character.
    int set(const char* property, const std::vector<std::string>& values);

    // Nothing when the property is not available now.
    std::optional<bool> getFlag(const char* property) const;
    std::optional<int64_t> getInt(const char* property) const;
    std::optional<double> getDouble(const char* property) const;
    std::optional<std::string> getString(const char* property) const;
    bool getNode(const char* property, MpvNode& node) const;

    // The direction in which media play.
    int setBackward(bool backward);
    bool isBackward() const;

    int command(std::initializer_list<const char*> arguments);
    // A seek to or by a time; flags as mpv writes them, "absolute+exact".
    int seek(double seconds, const char* flags);
    // The same without waiting. mpv's answer comes among its events, before that of the
    // seek itself.
    int requestSeek(double seconds, const char* flags);

private:
    int setProperty(const char* property, mpv_format format, void* value);
    bool getProperty(const char* property, mpv_format format, void* value) const;

    std::atomic<mpv_handle*> mHandle{nullptr};
    SharedLog mLog;
};

}  // namespace orvtarn
