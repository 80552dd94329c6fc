// SPDX-License-Identifier: Apache-2.0
#include "Streams.h"

#include <algorithm>
#include <atomic>

#include "Progress.h"

namespace stress {

struct Streams::Held {
    std::unique_ptr<IOrvStreamSource> stream;
    std::atomic<uint32_t> player{0};  // the number in all that it gives; 0 until known
    int locked = 0;                   // counted with the stream's own lock held
    std::atomic<int> lockings{0};
};

Streams::~Streams() {
    for (const auto& held : mStreams) {
        if (held->locked != held->lockings) {
            mWorld.faults.add("a stream's lock let two threads in");
        }
    }
}

void Streams::add(IOrvStreamSource* stream) {
    auto held = std::make_shared<Held>();
    held->stream.reset(stream);
    std::lock_guard<std::mutex> lock(mMutex);
    mStreams.push_back(std::move(held));
}

std::shared_ptr<Streams::Held> Streams::pick(Random& random) {
    std::lock_guard<std::mutex> lock(mMutex);
    if (mStreams.empty()) return nullptr;
    const uint32_t latest = std::min<uint32_t>(static_cast<uint32_t>(mStreams.size()), 4);
    return mStreams[mStreams.size() - 1 - random.below(latest)];
}

// All of a stream is one player's.
void Streams::checkNumber(const char* what, uint32_t value, uint32_t base, Held& held) {
    uint32_t known = 0;
    const uint32_t number = value - base;
    if (held.player.compare_exchange_strong(known, number, std::memory_order_relaxed)) return;
    if (known != number) {
        mWorld.faults.add(std::string("a stream's ") + what + " is " + std::to_string(value) +
                          ", of another player than " + std::to_string(known));
    }
}

void Streams::read(Held& held) {
    char bytes[kReadBufferSize] = {};
    int count = -1;
    const int result = held.stream->read(bytes, sizeof bytes, count);
    if (result == ORV_STREAM_ERROR_CODE_EOF && count == 0) return;  // it was made invalid
    if (result != ORV_STREAM_ERROR_CODE_OK || count != kReadBufferSize) {
        mWorld.faults.add("a read gave " + std::to_string(result) + " and " +
                          std::to_string(count));
        return;
    }
    const bool same = std::all_of(bytes, bytes + count, [&](char b) { return b == bytes[0]; });
    const uint32_t known = held.player.load(std::memory_order_relaxed);
    const bool right = known == 0 || static_cast<uint8_t>(bytes[0]) == static_cast<uint8_t>(known);
    if (!same || !right) mWorld.faults.add("a read gave bytes of another player");
}

void Streams::use(Random& random) {
    const std::shared_ptr<Held> held = pick(random);
    step();
    if (held == nullptr) return;
    IOrvStreamSource& stream = *held->stream;
    switch (random.below(12)) {
        case 0:
            return checkNumber("length", stream.getFileLength(), 1000000, *held);
        case 1:
            return checkNumber("position", static_cast<uint32_t>(stream.getCurrentPosition()),
                               2000000, *held);
        case 2:
            return checkNumber("duration", stream.getDuration(), 3000000, *held);
        case 3:
            stream.lock();
            held->locked++;
            held->lockings.fetch_add(1, std::memory_order_relaxed);
            stream.unlock();
            return;
        case 4:
            stream.byteSeek(E_ORV_STREAM_SEEK_SET, 0);
            return;
        case 5:
            stream.timeSeek(0, 1);
            return;
        case 6:
            stream.cancelRead();
            return;
        case 7:
            if (random.oneIn(8)) stream.setInvalid();
            return;
        case 8:
            stream.setThreadSelf();
            stream.isSeekable();
            return;
        case 9:
            stream.isStallingSupport();
            stream.getSeekType();
            return;
        default:
            return read(*held);
    }
}

}  // namespace stress
