// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stddef.h>

#include <memory>
#include <string>
#include <vector>

extern "C" {
#include <libavutil/frame.h>
}

namespace orvtarn {

struct FreeFrame {
    void operator()(AVFrame* frame) const { av_frame_free(&frame); }
};
typedef std::unique_ptr<AVFrame, FreeFrame> Frame;

// Runs successive frames of one size and pixel format through a graph in
// libavfilter's syntax that gives a frame for a frame, and takes the one that
// belongs to frames[wanted]. The frames stay as they are. Null for a graph that
// cannot be built or fails. Blocks while it works, on as many threads as there
// are cores.
Frame filterFrames(const std::string& graph, const std::vector<const AVFrame*>& frames,
                   size_t wanted);

}  // namespace orvtarn
