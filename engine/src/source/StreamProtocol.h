// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <mpv/client.h>

#include <memory>
#include <mutex>

#include "source/MediaSource.h"

struct mpv_stream_cb_info;

namespace orvtarn {

// Lets mpv read the current source's bytes, on mpv's
// threads. A read that fails is remembered in the source: to mpv it looks
// like the end.
class StreamProtocol {
public:
    // Once, for the whole life of mpv; this must outlive it.
    bool install(mpv_handle* mpv);
    // What mpv opens from now on; null for nothing.
    void setSource(std::shared_ptr<MediaSource> source);

private:
    static int open(void* self, char* name, mpv_stream_cb_info* info);

    std::mutex mMutex;
    std::shared_ptr<MediaSource> mSource;
};

}  // namespace orvtarn
