// SPDX-License-Identifier: Apache-2.0
#include "LibavFailure.h"

#include <stddef.h>
#include <stdint.h>

#include <mutex>

extern "C" {
#include <libavutil/error.h>
}

namespace orvtest {
namespace {

constexpr int kNoMemory = AVERROR(ENOMEM);
constexpr int kBroken = AVERROR_INVALIDDATA;

std::mutex gMutex;
std::string gFunction;
int gFrom = 0;
int gCalls = 0;

bool mustFail(const char* function) {
    std::lock_guard<std::mutex> lock(gMutex);
    return gFunction == function && ++gCalls >= gFrom;
}

}  // namespace

LibavFailure::LibavFailure(const std::string& function, int from) {
    std::lock_guard<std::mutex> lock(gMutex);
    gFunction = function;
    gFrom = from;
    gCalls = 0;
}

LibavFailure::~LibavFailure() {
    std::lock_guard<std::mutex> lock(gMutex);
    gFunction.clear();
}

int LibavFailure::count() const {
    std::lock_guard<std::mutex> lock(gMutex);
    return gCalls >= gFrom ? gCalls - gFrom + 1 : 0;
}

}  // namespace orvtest

// The linker knows names alone: pointers to libav's records are those to anything here.
#define ORV_WRAP(Result, name, parameters, arguments, failure)                   \
    extern "C" Result __real_##name parameters;                                  \
    extern "C" Result __wrap_##name parameters {                                 \
        return orvtest::mustFail(#name) ? (failure) : (__real_##name arguments); \
    }

using orvtest::kBroken;
using orvtest::kNoMemory;

ORV_WRAP(void*, av_malloc, (size_t a), (a), nullptr)
ORV_WRAP(void*, av_packet_alloc, (), (), nullptr)
ORV_WRAP(void*, av_frame_alloc, (), (), nullptr)
ORV_WRAP(void*, av_frame_clone, (const void* a), (a), nullptr)
ORV_WRAP(int, av_frame_get_buffer, (void* a, int b), (a, b), kNoMemory)
ORV_WRAP(int, av_read_frame, (void* a, void* b), (a, b), kBroken)
ORV_WRAP(int, av_seek_frame, (void* a, int b, int64_t c, int d), (a, b, c, d), kBroken)
ORV_WRAP(void*, avformat_alloc_context, (), (), nullptr)
ORV_WRAP(int, avformat_find_stream_info, (void* a, void** b), (a, b), kNoMemory)
ORV_WRAP(void*, avio_alloc_context, (uint8_t* a, int b, int c, void* d, void* e, void* f, void* g),
         (a, b, c, d, e, f, g), nullptr)
ORV_WRAP(void*, avcodec_alloc_context3, (const void* a), (a), nullptr)
ORV_WRAP(int, avcodec_parameters_to_context, (void* a, const void* b), (a, b), kNoMemory)
ORV_WRAP(int, avcodec_open2, (void* a, const void* b, void** c), (a, b, c), kBroken)
ORV_WRAP(int, avcodec_send_packet, (void* a, const void* b), (a, b), kBroken)
ORV_WRAP(int, avcodec_receive_frame, (void* a, void* b), (a, b), kBroken)
ORV_WRAP(void*, sws_getContext,
         (int a, int b, int c, int d, int e, int f, int g, void* h, void* i, const double* j),
         (a, b, c, d, e, f, g, h, i, j), nullptr)
ORV_WRAP(int, sws_scale,
         (void* a, const uint8_t* const b[], const int c[], int d, int e, uint8_t* const f[],
          const int g[]),
         (a, b, c, d, e, f, g), kBroken)
ORV_WRAP(void*, avfilter_graph_alloc, (), (), nullptr)
ORV_WRAP(void*, avfilter_graph_alloc_filter, (void* a, const void* b, const char* c), (a, b, c),
         nullptr)
ORV_WRAP(int, avfilter_graph_create_filter,
         (void** a, const void* b, const char* c, const char* d, void* e, void* f),
         (a, b, c, d, e, f), kNoMemory)
ORV_WRAP(int, avfilter_graph_parse2, (void* a, const char* b, void** c, void** d), (a, b, c, d),
         kNoMemory)
ORV_WRAP(int, avfilter_link, (void* a, unsigned b, void* c, unsigned d), (a, b, c, d), kBroken)
ORV_WRAP(int, avfilter_init_str, (void* a, const char* b), (a, b), kBroken)
ORV_WRAP(int, avfilter_graph_config, (void* a, void* b), (a, b), kBroken)
ORV_WRAP(void*, av_buffersrc_parameters_alloc, (), (), nullptr)
ORV_WRAP(int, av_buffersrc_parameters_set, (void* a, void* b), (a, b), kBroken)
ORV_WRAP(int, av_buffersrc_add_frame, (void* a, void* b), (a, b), kNoMemory)
ORV_WRAP(int, av_buffersink_get_frame, (void* a, void* b), (a, b), kBroken)
