// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mpv/client.h>

#include <memory>
#include <mutex>

#include "MediaSource.h"

struct mpv_stream_cb_info;

namespace orvtarn {

// Lets the playback core read the current source's bytes, on the core's
// threads. A read that fails is remembered in the source: to the core it looks
// like the end.
class StreamProtocol {
public:
    // Once, for the whole life of the core; this must outlive it.
    bool install(mpv_handle* mpv);
    // What the core opens from now on; null for nothing.
    void setSource(std::shared_ptr<MediaSource> source);

private:
    static int open(void* self, char* name, mpv_stream_cb_info* info);

    std::mutex mMutex;
    std::shared_ptr<MediaSource> mSource;
};

}  // namespace orvtarn
