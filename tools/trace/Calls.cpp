// SPDX-License-Identifier: Apache-2.0
#include "Calls.h"

namespace orvtrace {

namespace {

constexpr size_t kNowhere = SIZE_MAX;
// A failure's text in a trace; paths in it may be long.
constexpr size_t kMaxFailureText = 200;
// Deeper than the native half ever goes: an enter line whose leave line never comes.
constexpr size_t kMaxDepth = 64;

bool isTimedPair(const NativeMethod* method) {
    return method == nullptr || method->trail == Trail::kPair;
}

// What calls Java, which may call native methods again.
bool callsJava(std::string_view name) {
    return name == "callback" || name.substr(0, 17) == "JavaInputStream::" ||
           name == "MsgDispatcher::notify";
}

// The method whose last line has the name, if the open call may be of it.
const NativeMethod* methodLeft(const NativeMethod& entered, std::string_view name) {
    const NativeMethod* left = findLeft(name);
    if (left == nullptr) return nullptr;
    return left == &entered || mayBe(entered, *left) ? left : nullptr;
}

}  // namespace

void Calls::line(const LogLine& line, const Meaning& meaning, int64_t ns) {
    if (meaning.kind == Meaning::Kind::kLoad) closeProcess(line.pid);
    Thread& thread = threadOf(line);
    thread.timed = line.time.known;
    switch (meaning.kind) {
        case Meaning::Kind::kEnter:
        case Meaning::Kind::kOccur:
            enter(thread, line, meaning, ns);
            break;
        case Meaning::Kind::kLeave:
            leave(thread, meaning.name, ns);
            break;
        default:
            if (meaning.failure) fail(thread, line.text);
    }
    if (ns > thread.last) mShortestStep = std::min(mShortestStep, ns - thread.last);
    thread.last = ns;
    if (meaning.mark != Mark::kNone) {
        mSink.mark(
            {thread.track, Moment(ns, line.time.text), meaning.mark, line.priority, line.text});
    }
}

Calls::Thread& Calls::threadOf(const LogLine& line) {
    const uint64_t key = static_cast<uint64_t>(line.pid) << 32 | static_cast<uint32_t>(line.tid);
    const auto found = mThreads.find(key);
    if (found != mThreads.end()) return found->second;
    if (mThreads.size() >= kMaxThreads) forgetThreads();
    Thread& thread = mThreads[key];
    thread.track = {line.pid, line.tid};
    mSink.track(thread.track, "thread " + std::to_string(line.tid));
    return thread;
}

void Calls::enter(Thread& thread, const LogLine& line, const Meaning& meaning, int64_t ns) {
    const Moment now(ns, line.time.text);
    const NativeMethod* method = findEntered(meaning.name);
    if (method != nullptr) {
        enterNative(thread, *method, now);
        return;
    }
    if (meaning.kind == Meaning::Kind::kOccur) return;
    while (!thread.open.empty() &&
           (!thread.open.back().awaitsLeave || isOpenAgain(thread.open.back(), meaning.name) ||
            thread.open.size() >= kMaxDepth)) {
        close(thread, thread.last, true);
    }
    thread.open.push_back({std::string(meaning.name), nullptr, now, true, false, {}});
}

// None of what is no native method calls itself: its line that leaves is missing.
bool Calls::isOpenAgain(const Open& open, std::string_view name) {
    return open.method == nullptr && open.name == name;
}

void Calls::enterNative(Thread& thread, const NativeMethod& method, const Moment& now) {
    // It begins inside of what is open only if that calls it, or Java.
    while (!thread.open.empty()) {
        const Open& top = thread.open.back();
        const bool inside =
            top.method != nullptr ? calls(*top.method, method) : callsJava(top.name);
        if (inside && thread.open.size() < kMaxDepth) break;
        close(thread, thread.last, top.awaitsLeave);
    }
    thread.open.push_back({method.name, &method, now, isTimedPair(&method), false, {}});
}

void Calls::leave(Thread& thread, std::string_view name, int64_t ns) {
    size_t at = kNowhere;
    for (size_t i = thread.open.size(); i-- > 0 && at == kNowhere;) {
        const Open& open = thread.open[i];
        const bool leaves =
            open.method != nullptr ? methodLeft(*open.method, name) != nullptr : open.name == name;
        if (open.awaitsLeave && leaves) at = i;
    }
    if (at == kNowhere) {
        ++mStrayLeaves;
        return;
    }
    closeDownTo(thread, at + 1);
    rename(thread.open[at], name);
    close(thread, ns, false);
}

// The failure is that of all native methods that are being called: of one inside another, too.
void Calls::fail(Thread& thread, std::string_view text) {
    for (Open& open : thread.open) {
        rename(open, text.substr(0, text.find('(')));
        if (open.failed) continue;
        open.failed = true;
        open.failure = text.substr(0, kMaxFailureText);
    }
}

// A failure names the method where its first line has named another.
void Calls::rename(Open& open, std::string_view name) {
    const NativeMethod* named = open.method != nullptr ? methodLeft(*open.method, name) : nullptr;
    if (named == nullptr) return;
    open.method = named;
    open.name = named->name;
}

void Calls::closeDownTo(Thread& thread, size_t depth) {
    while (thread.open.size() > depth) {
        close(thread, thread.last, thread.open.back().awaitsLeave);
    }
}

void Calls::close(Thread& thread, int64_t end, bool leaveMissing) {
    const Open open = std::move(thread.open.back());
    thread.open.pop_back();
    Span span;
    span.track = thread.track;
    span.name = open.name;
    span.method = open.method;
    span.begin = open.begin;
    span.end = std::max(end, open.begin.ns);
    span.timed = thread.timed && open.awaitsLeave && !leaveMissing && end >= open.begin.ns;
    span.failed = open.failed;
    span.leaveMissing = leaveMissing;
    span.failure = open.failure;
    mSink.span(span);
}

void Calls::closeProcess(int pid) {
    for (auto& [key, thread] : mThreads) {
        if (thread.track.pid == pid) closeDownTo(thread, 0);
    }
}

void Calls::forgetThreads() {
    for (auto thread = mThreads.begin(); thread != mThreads.end();) {
        thread = thread->second.open.empty() ? mThreads.erase(thread) : std::next(thread);
    }
    if (mThreads.size() < kMaxThreads) return;
    finish();
    mThreads.clear();
}

void Calls::finish() {
    for (auto& [key, thread] : mThreads) closeDownTo(thread, 0);
}

}  // namespace orvtrace
