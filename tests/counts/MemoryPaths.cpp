// SPDX-License-Identifier: Apache-2.0
// Bytes that go through the library: streams, pictures, the pool.
#include <memory>
#include <vector>

#include "Counting.h"
#include "Machine.h"
#include "Paths.h"
#include "os/MemoryPool.h"
#include "stream/JavaInputStream.h"

namespace orvcounts {
namespace {

using fakejni::Value;

// What the engine does to read, on a thread that Java does not know.
template <int Length>
void streamRead(int times) {
    Machine machine;
    machine.playerClass.remove("readStream");
    machine.playerClass.method("readStream", "(I)I",
                               [](const fakejni::Invocation& call) { return call.args.at(0); });
    const fakejni::ObjectPtr player = machine.newPlayer();
    player->set("mStreamReadBuffer",
                Value::of(machine.vm.newBytes(std::vector<uint8_t>(Length, 'm'))));
    auto stream = std::make_unique<JavaInputStream>(machine.vm.env(), machine.vm.local(player));
    std::vector<char> buffer(Length);
    machine.vm.onNativeThread([&] {
        repeat(times, [&](const Runner& counted) {
            int count = 0;
            buffer.back() = 0;
            counted([&] { stream->read(buffer.data(), Length, count); });
            require(count == Length && buffer.back() == 'm', "too few bytes were read");
        });
    });
    stream.reset();
    machine.release(player);
}

// Rows of 1000 bytes, which the engine pads to 1024.
void thumbnail(int times) {
    const int mode = 5;
    const int width = 250;
    const int height = 140;
    Machine machine;
    fakejni::Class& type = machine.vm.define("com/quintora/mmp/util/ThumbnailInfo");
    for (const char* field : {"mCanvasColormode", "mThumbnailWidth", "mThumbnailHeight"}) {
        type.field(field, "I");
    }
    const fakejni::ObjectPtr request = machine.vm.newObject(type.path);
    request->set("mCanvasColormode", Value::ofInt(mode));
    request->set("mThumbnailWidth", Value::ofInt(width));
    request->set("mThumbnailHeight", Value::ofInt(height));
    const fakejni::ObjectPtr player = machine.newPlayer();
    machine.engine->drawThumbnail = [](_Media_Thumbnail_Info_T*) {};
    repeat(times, [&](const Runner& counted) {
        Value picture;
        counted([&] {
            picture = machine.call<jbyteArray>(player, "native_getThumbnailInfo",
                                               "(Lcom/quintora/mmp/util/ThumbnailInfo;)[B",
                                               machine.vm.local(request));
        });
        require(picture.object != nullptr && picture.object->bytes.size() == 4 * width * height,
                "the picture has another size");
    });
    machine.release(player);
}

void pool(int times) {
    require(mem_init() == 0, "there is no pool");
    repeat(times, [](const Runner& counted) {
        counted([] {
            void* memory = mem_alloc(1000);
            require(memory != nullptr, "the pool is empty");
            mem_free(memory);
        });
    });
}

}  // namespace

const Path kMemoryPaths[] = {
    {"stream_read_4KiB", streamRead<4 << 10>},
    {"stream_read_64KiB", streamRead<64 << 10>},
    {"thumbnail_packing", thumbnail},
    {"pool_allocation", pool},
};

}  // namespace orvcounts
