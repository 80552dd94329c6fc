// SPDX-License-Identifier: Apache-2.0
//
// The stream over a Java player whose Java side lies: counts beyond what was asked
// for or beyond its own array, negative ones, no array, exceptions at any time.
// Input, a call a line: "read LENGTH COUNT ARRAY" (ARRAY bytes long, negative for
// none), "seek TYPE OFFSET RESULT", "timeSeek FIRST SECOND RESULT", "size N",
// "position N", "duration N", "type N", "seekable N", "stalling N", "seekType N",
// "cancel", "close", "invalid", "lock", and before one of them "throw" or, for a
// read during which the engine gives up, "stop".
#include <algorithm>
#include <memory>
#include <thread>

#include "stream/JavaInputStream.h"
#include "support/LockCount.h"
#include "support/PlayerMachine.h"
#include "support/Require.h"
#include "support/Words.h"

namespace {

using fakejni::Invocation;
using fakejni::Value;
using orvfuzz::require;

constexpr int kMostBytes = 1 << 12;
constexpr char kGuard = 0x5A;

// How Java answers next.
struct JavaSide {
    int64_t result = 0;
    int array = -1;  // bytes of mStreamReadBuffer
    bool throws = false;
    bool stops = false;  // the engine gives up meanwhile
};

uint8_t byteAt(size_t offset) { return static_cast<uint8_t>(offset * 7 + 1); }

class HostileStream {
public:
    HostileStream() {
        define("readStream", "(I)I", [this](const Invocation& call) { return readStream(call); });
        define("seekStream", "(IJ)J", [this](const Invocation& call) { return longAnswer(call); });
        define("seekStreamEx", "(IJ)J",
               [this](const Invocation& call) { return longAnswer(call); });
        define("timeSeekStream", "(JJ)J",
               [this](const Invocation& call) { return longAnswer(call); });
        define("getSeekType", "()I", [this](const Invocation& call) {
            return Value::ofInt(static_cast<jint>(longAnswer(call).integer));
        });
        for (const char* name : {"cancelRead", "closeStream"}) {
            define(name, "()V", [this](const Invocation& call) {
                longAnswer(call);
                return Value();
            });
        }
        machine.initClass();
        stream =
            std::make_unique<JavaInputStream>(machine.vm.env(), machine.vm.local(machine.player));
    }

    // On the engine's thread, which is attached only within a call.
    void run(orvfuzz::Words& words) {
        while (!words.atEnd()) {
            const std::string_view word = words.next();
            if (word == "throw") {
                java.throws = true;
            } else if (word == "stop") {
                java.stops = true;
            } else {
                const bool leftAttached = call(word, words);
                require(orvfuzz::heldLocks() == 0, "no call leaves a lock held");
                require(machine.vm.isAttached() == leftAttached, "a call detaches its thread");
                if (leftAttached) machine.vm.detach();
                java = JavaSide();
            }
        }
    }

    void finish() {
        stream.reset();
        machine.finish();
    }

private:
    void define(const char* name, const char* signature, fakejni::Implementation body) {
        machine.redefine(name, signature, std::move(body));
    }

    Value longAnswer(const Invocation& call) {
        if (java.throws) call.vm.raise("java/lang/IllegalStateException");
        return Value::ofLong(java.result);
    }
    Value readStream(const Invocation& call) {
        std::vector<uint8_t> bytes(static_cast<size_t>(std::max(0, java.array)));
        for (size_t i = 0; i < bytes.size(); i++) bytes[i] = byteAt(i);
        call.self->set("mStreamReadBuffer",
                       Value::of(java.array < 0 ? nullptr : call.vm.newBytes(bytes)));
        if (java.stops) stream->setInvalid();
        return Value::ofInt(static_cast<jint>(longAnswer(call).integer));
    }

    // True for the one call that leaves its thread attached, by contract.
    bool call(std::string_view word, orvfuzz::Words& words) {
        if (word == "read") return read(words);
        if (word == "seek" || word == "timeSeek") seek(word, words);
        if (word == "size" || word == "position" || word == "duration") longField(word, words);
        if (word == "type" || word == "seekable" || word == "stalling") intField(word, words);
        if (word == "seekType") {
            java.result = words.int32();
            require(stream->getSeekType() == (java.throws ? 0 : java.result), "seekType is Java's");
        }
        if (word == "cancel") stream->cancelRead();
        if (word == "close") stream->closeStream();
        if (word == "invalid") stream->setInvalid();
        if (word == "lock") {
            stream->lock();
            stream->unlock();
        }
        return false;
    }

    bool read(orvfuzz::Words& words) {
        const int length = words.below(kMostBytes);
        java.result = words.int32();
        java.array = std::min(words.int32(), kMostBytes);
        const bool wasValid = stream->isValid();
        // With one byte more, which no read may touch.
        std::vector<char> buffer(static_cast<size_t>(length) + 1, kGuard);
        int count = -7;
        const int status = stream->read(buffer.data(), length, count);
        require(buffer.back() == kGuard, "a read ends with its buffer");
        const bool asked = wasValid && !java.throws;
        const bool arrived = asked && java.result > 0 && !java.stops;
        require((status == ORV_STREAM_ERROR_CODE_OK) == arrived, "a read succeeds as Java's did");
        require(count == (arrived ? java.result : 0), "the count is Java's");
        const auto copied = static_cast<size_t>(
            arrived ? std::max<int64_t>(0, std::min<int64_t>({java.result, java.array, length}))
                    : 0);
        for (size_t i = 0; i < buffer.size(); i++) {
            const char expected = i < copied ? static_cast<char>(byteAt(i)) : kGuard;
            require(buffer[i] == expected, "Java's bytes arrive, and no other");
        }
        return asked && java.result > 0 && java.stops;
    }

    void seek(std::string_view word, orvfuzz::Words& words) {
        const int64_t first = words.number();
        const int64_t second = words.number();
        java.result = words.number();
        const long long place =
            word == "seek" ? stream->byteSeek(static_cast<E_Orv_Stream_Seek_Type>(first), second)
                           : stream->timeSeek(first, second);
        const int64_t expected = !stream->isValid() ? -1 : java.throws ? 0 : java.result;
        require(place == expected, "the place is Java's");
    }

    void longField(std::string_view word, orvfuzz::Words& words) {
        const int64_t value = words.number();
        const char* field = word == "size"       ? "mStreamSize"
                            : word == "position" ? "mStreamCurPos"
                                                 : "mStreamDuration";
        machine.player->set(field, Value::ofLong(value));
        if (word == "size") {
            const auto expected = static_cast<uint32_t>(value == 0 ? -1 : value);
            require(stream->getFileLength() == expected, "the length is Java's low 32 bits");
        } else if (word == "position") {
            require(stream->getCurrentPosition() == value, "the position is Java's");
        } else {
            require(stream->getDuration() == static_cast<uint32_t>(value),
                    "the duration is Java's low 32 bits");
        }
    }

    void intField(std::string_view word, orvfuzz::Words& words) {
        const int32_t value = words.int32();
        if (word == "type") {
            machine.player->set("mDataSourceType", Value::ofInt(value));
            require(stream->getDataSourceType() == 0, "the source's type is the first one");
        } else if (word == "seekable") {
            machine.player->set("mStreamSeekable", Value::ofBoolean(value != 0));
            require(stream->isSeekable() == (value != 0), "seekable is Java's");
        } else {
            machine.player->set("mStallingSupport", Value::ofBoolean(value != 0));
            require(stream->isStallingSupport() == (value != 0), "stalling is Java's");
        }
    }

    orvfuzz::PlayerMachine machine;
    std::unique_ptr<JavaInputStream> stream;
    JavaSide java;
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    orvfuzz::Words words(data, size);
    HostileStream stream;
    std::thread([&] { stream.run(words); }).join();
    stream.finish();
    return 0;
}
