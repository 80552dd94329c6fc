// SPDX-License-Identifier: Apache-2.0
#include "Statistics.h"

namespace orvtrace {

void Statistics::span(const Span& span) {
    if (span.method == nullptr) return;
    ++mCalls;
    std::unique_ptr<MethodCalls>& calls = mMethods[span.method];
    if (calls == nullptr) {
        calls = std::make_unique<MethodCalls>();
        calls->method = span.method;
    }
    ++calls->calls;
    if (span.failed) ++calls->failed;
    if (span.leaveMissing) ++calls->leaveMissing;
    if (!span.timed) return;
    const int64_t time = span.end - span.begin.ns;
    if (calls->times.count() == 0 || time < calls->shortest) calls->shortest = time;
    if (calls->times.count() == 0 || time > calls->longest) {
        calls->longest = time;
        calls->longestAt = span.begin;
    }
    calls->times.add(time);
    calls->total += time;
}

void Statistics::mark(const MarkAt& mark) { ++mMarks[static_cast<int>(mark.kind)]; }

uint64_t Statistics::marks(Mark kind) const { return mMarks[static_cast<int>(kind)]; }

std::vector<const MethodCalls*> Statistics::methods() const {
    std::vector<const MethodCalls*> methods;
    for (const auto& [method, calls] : mMethods) methods.push_back(calls.get());
    std::sort(methods.begin(), methods.end(), [](const MethodCalls* a, const MethodCalls* b) {
        if (a->total != b->total) return a->total > b->total;
        if (a->calls != b->calls) return a->calls > b->calls;
        return a->method < b->method;
    });
    return methods;
}

}  // namespace orvtrace
