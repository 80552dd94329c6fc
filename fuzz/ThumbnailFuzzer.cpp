// SPDX-License-Identifier: Apache-2.0
//
// Thumbnail requests of any size, drawn by an engine that fills its buffer to the
// last byte. Input: "MODE WIDTH HEIGHT DRAWN" any number of times; DRAWN 0 has the
// engine refuse, a negative one the n-th call of the machine fail. A request has
// at most 255 rows by contract.
#include <string.h>

#include "support/PlayerMachine.h"
#include "support/Require.h"
#include "support/Words.h"

namespace {

using fakejni::Value;
using orvfuzz::require;

constexpr char kClass[] = "com/quintora/mmp/util/ThumbnailInfo";
// A buffer that large is left to the allocator's own limit: it would take all the
// time there is.
constexpr uint64_t kMostBytes = 1 << 16;

struct Request {
    int mode;
    int width;
    int height;
    int drawn;

    uint64_t pixelBytes() const {
        switch (mode) {
            case 5:
            case 12:
            case 17:
            case 18:
                return 4;
            case 3:
            case 4:
            case 9:
            case 10:
            case 11:
            case 15:
            case 16:
                return 2;
            default:
                return 0;
        }
    }
    // In 32 bits by contract; the size of all rows in as many as it takes.
    uint64_t rowBytes() const {
        return static_cast<uint32_t>(pixelBytes() * static_cast<uint32_t>(width));
    }
    uint64_t paddedRowBytes() const { return static_cast<uint32_t>(rowBytes() + 63) / 64 * 64; }
    uint64_t paddedSize() const { return paddedRowBytes() * static_cast<uint64_t>(height); }
};

uint8_t pixelAt(uint64_t offset) { return static_cast<uint8_t>(offset * 31 + offset / 256); }

// Every byte is drawn: behind the last one a sanitizer watches.
void draw(_Media_Thumbnail_Info_T* request) {
    for (uint32_t i = 0; i < request->u4BufferSize; i++) request->pBuffer[i] = pixelAt(i);
}

void requirePicture(const Request& request, const std::vector<uint8_t>& bytes) {
    require(bytes.size() == request.rowBytes() * static_cast<uint64_t>(request.height),
            "a picture has its rows without their padding");
    for (uint64_t row = 0; row < static_cast<uint64_t>(request.height); row++) {
        for (uint64_t i = 0; i < request.rowBytes(); i++) {
            require(
                bytes[row * request.rowBytes() + i] == pixelAt(row * request.paddedRowBytes() + i),
                "every row holds its own pixels");
        }
    }
}

void ask(orvfuzz::PlayerMachine& machine, orvtest::ScriptedEngine& engine, const Request& request) {
    fakejni::Vm& vm = machine.vm;
    const fakejni::ObjectPtr info = vm.newObject(kClass);
    info->set("mCanvasColormode", Value::ofInt(request.mode));
    info->set("mThumbnailWidth", Value::ofInt(request.width));
    info->set("mThumbnailHeight", Value::ofInt(request.height));
    engine.answer("getThumbnailInfo", {request.drawn > 0});
    engine.drawThumbnail = request.drawn != 0 ? draw : [](_Media_Thumbnail_Info_T*) {};
    const int failures = vm.failures();
    if (request.drawn < 0) vm.failNth(-(request.drawn % 16));
    const fakejni::NativeResult result = machine.call<jbyteArray>(
        "native_getThumbnailInfo", "(Lcom/quintora/mmp/util/ThumbnailInfo;)[B", vm.local(info));
    const bool failed = vm.failures() != failures;
    vm.forgetFailures();
    const uint64_t padded = request.paddedSize();
    const bool exists = padded != 0 && padded <= UINT32_MAX && request.drawn > 0;
    if (failed || !exists) {
        require(result.value.object == nullptr, "without a picture there is null");
    } else {
        require(result.value.object != nullptr, "a drawn picture arrives");
        requirePicture(request, result.value.object->bytes);
    }
    require(failed || !vm.pending().has_value(), "only the machine's failures throw");
    vm.clearPending();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    orvfuzz::Words words(data, size);
    orvfuzz::PlayerMachine machine;
    orvtest::ScriptedEngine& engine = machine.setUp();
    while (!words.atEnd()) {
        Request request = {words.int32(), words.int32(), words.int32(), words.int32()};
        request.height = static_cast<uint8_t>(request.height);
        // Sizes that no buffer has are tried; those that take long are not.
        const bool isLarge = request.paddedSize() > kMostBytes;
        if (isLarge && request.paddedSize() <= UINT32_MAX) continue;
        ask(machine, engine, request);
    }
    machine.finish();
    return 0;
}
