// SPDX-License-Identifier: Apache-2.0
#include "inspect/FilterGraph.h"

#include "base/LibraryVersions.h"
#include "inspect/StreamPicture.h"

extern "C" {
#include <libavfilter/avfilter.h>
#include <libavfilter/buffersink.h>
#include <libavfilter/buffersrc.h>
#include <libavutil/mem.h>
}

namespace orvtarn {
namespace {

struct FreeGraph {
    void operator()(AVFilterGraph* graph) const { avfilter_graph_free(&graph); }
};
struct FreeEnds {
    void operator()(AVFilterInOut* ends) const { avfilter_inout_free(&ends); }
};
struct FreeMemory {
    void operator()(void* memory) const { av_free(memory); }
};

// A graph with a source and a sink around the filters.
class Graph {
public:
    bool build(const std::string& text, const AVFrame& like) {
        mGraph.reset(avfilter_graph_alloc());
        return mGraph != nullptr && addSource(like) && addSink() && addFilters(text) &&
               avfilter_graph_config(mGraph.get(), nullptr) >= 0;
    }

    // A null frame is the end.
    bool push(AVFrame* frame) { return av_buffersrc_add_frame(mSource, frame) >= 0; }

    Frame pull() {
        Frame frame(av_frame_alloc());
        if (frame == nullptr || av_buffersink_get_frame(mSink, frame.get()) < 0) return nullptr;
        return frame;
    }

private:
    bool addSource(const AVFrame& like) {
        mSource = avfilter_graph_alloc_filter(mGraph.get(), avfilter_get_by_name("buffer"), "in");
        const std::unique_ptr<AVBufferSrcParameters, FreeMemory> parameters(
            av_buffersrc_parameters_alloc());
        if (mSource == nullptr || parameters == nullptr) return false;
        parameters->format = like.format;
        parameters->width = like.width;
        parameters->height = like.height;
        parameters->time_base = {1, 25};
        setSourceColors(*parameters, like);
        return av_buffersrc_parameters_set(mSource, parameters.get()) >= 0 &&
               avfilter_init_str(mSource, nullptr) >= 0;
    }

    bool addSink() {
        return avfilter_graph_create_filter(&mSink, avfilter_get_by_name("buffersink"), "out",
                                            nullptr, nullptr, mGraph.get()) >= 0;
    }

    bool addFilters(const std::string& text) {
        AVFilterInOut* inputs = nullptr;
        AVFilterInOut* outputs = nullptr;
        const int error = avfilter_graph_parse2(mGraph.get(), text.c_str(), &inputs, &outputs);
        const std::unique_ptr<AVFilterInOut, FreeEnds> first(inputs);
        const std::unique_ptr<AVFilterInOut, FreeEnds> last(outputs);
        return error >= 0 && first != nullptr && last != nullptr &&
               avfilter_link(mSource, 0, first->filter_ctx,
                             static_cast<unsigned>(first->pad_idx)) >= 0 &&
               avfilter_link(last->filter_ctx, static_cast<unsigned>(last->pad_idx), mSink, 0) >= 0;
    }

    std::unique_ptr<AVFilterGraph, FreeGraph> mGraph;
    AVFilterContext* mSource = nullptr;
    AVFilterContext* mSink = nullptr;
};

// Another reference to the frame, with its place as its time. It names the
// matrix, which is guessed by a size that turning changes.
Frame numbered(const AVFrame& frame, size_t place) {
    Frame copy(av_frame_clone(&frame));
    if (copy == nullptr) return nullptr;
    copy->pts = static_cast<int64_t>(place);
    copy->colorspace = matrixOf(frame);
    return copy;
}

}  // namespace

Frame filterFrames(const std::string& graph, const std::vector<const AVFrame*>& frames,
                   size_t wanted) {
    Graph filters;
    const Frame like = frames.empty() ? nullptr : numbered(*frames[0], 0);
    if (like == nullptr || !filters.build(graph, *like)) return nullptr;
    for (size_t i = 0; i < frames.size(); i++) {
        const Frame frame = numbered(*frames[i], i);
        if (frame == nullptr || !filters.push(frame.get())) return nullptr;
    }
    if (!filters.push(nullptr)) return nullptr;
    for (size_t i = 0; i < wanted; i++) {
        if (filters.pull() == nullptr) return nullptr;
    }
    return filters.pull();
}

}  // namespace orvtarn
