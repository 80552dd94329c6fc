// SPDX-License-Identifier: Apache-2.0
// Thumbnails and embedded pictures as Java byte arrays.
#include <string.h>

#include <numeric>

#include "JniFixture.h"
#include "PosixCalls.h"

namespace orvtest {
namespace {

using fakejni::Value;

using Bytes = std::vector<uint8_t>;

const std::string kThumbnailInfo = "com/quintora/mmp/util/ThumbnailInfo";
const ExpectedLine kModeNotUsed =
    bridgeError("####  OrvMediaCliengetThumbnailInfo(): thumbnail_Colormode not used now!\n");

Bytes counting(size_t size) {
    Bytes bytes(size);
    std::iota(bytes.begin(), bytes.end(), uint8_t{1});
    return bytes;
}

const ExpectedLine kNoMemory =
    bridgeError("####  OrvMediaCliengetThumbnailInfo(): Out of memory !!!\n");

class ThumbnailTest : public JniFixture {
protected:
    ThumbnailTest() {
        fakejni::Class& type = vm.define(kThumbnailInfo);
        for (const char* field : kFields) type.field(field, "I");
        request = vm.newObject(kThumbnailInfo);
    }

    // The padded buffer is drawn as 1, 2, 3, …
    ScriptedEngine& setUpEngine() {
        setUpPlayer().drawThumbnail = [](_Media_Thumbnail_Info_T* thumbnail) {
            const Bytes drawn = counting(thumbnail->u4BufferSize);
            std::copy(drawn.begin(), drawn.end(), thumbnail->pBuffer);
        };
        return *engine;
    }

    Outcome get(int mode, int width, int height) {
        const int values[] = {mode, width, height};
        for (int i = 0; i < 3; i++) {
            if (request->type->findField(kFields[i], "I", false) != nullptr) {
                request->set(kFields[i], Value::ofInt(values[i]));
            }
        }
        return observe("native_getThumbnailInfo", [&] {
            auto result = fakejni::callNative<jbyteArray>(
                vm, playerClass, vm.local(player), "native_getThumbnailInfo",
                "(Lcom/quintora/mmp/util/ThumbnailInfo;)[B", vm.local(request));
            if (result.value.object != nullptr) bytes = result.value.object->bytes;
            return result;
        });
    }

    // The lines up to and with the row width; the readers' own are among them.
    std::vector<ExpectedLine> linesTo(int mode, int width, int height, size_t fields = 3) const {
        const int values[] = {mode, width, height};
        std::vector<ExpectedLine> lines = {enter("OrvMediaClient_getThumbnailInfo")};
        for (size_t i = 0; i < fields; i++) {
            const std::string reader = "getIntValueFromJava(): ";
            lines.push_back(info(reader + "pszClassPath=" + kThumbnailInfo +
                                 ", pszVar_AliasName=" + kFields[i]));
            lines.push_back(info(reader + "i4Ret=" + std::to_string(values[i])));
        }
        return lines;
    }

    static constexpr const char* kFields[] = {"mCanvasColormode", "mThumbnailWidth",
                                              "mThumbnailHeight"};
    fakejni::ObjectPtr request;
    Bytes bytes;
    const ExpectedLine service = serviceInfo("OrvMediaService::getthumbnailinfo in");
    const ExpectedLine left = bridgeInfo("nativeGetThumbNailInfo(): Leave");
};

ExpectedLine widthLine(int width) {
    return bridgeError("width_new :" + std::to_string(width) + "\n");
}

TEST_F(ThumbnailTest, RowsArePackedTogether) {
    setUpEngine();
    std::vector<ExpectedLine> lines = linesTo(5, 10, 3);
    lines.insert(lines.end(), {widthLine(16), service, left});
    EXPECT_THAT(get(5, 10, 3),
                Returns("byte[120]").logs(lines).engine({"getThumbnailInfo(192, 5, 10, 3)"}));
    const Bytes drawn = counting(192);
    Bytes expected;
    for (int row = 0; row < 3; row++) {
        expected.insert(expected.end(), drawn.begin() + row * 64, drawn.begin() + row * 64 + 40);
    }
    EXPECT_EQ(bytes, expected);
}

TEST_F(ThumbnailTest, OneRowLosesItsPadding) {
    setUpEngine();
    EXPECT_EQ(get(5, 10, 1).returned, "byte[40]");
    EXPECT_EQ(bytes, counting(40));
}

TEST_F(ThumbnailTest, FullRowsDoNotMove) {
    setUpEngine();
    std::vector<ExpectedLine> lines = linesTo(3, 32, 4);
    lines.insert(lines.end(), {widthLine(32), service, left});
    EXPECT_THAT(get(3, 32, 4),
                Returns("byte[256]").logs(lines).engine({"getThumbnailInfo(256, 3, 32, 4)"}));
    EXPECT_EQ(bytes, counting(256));
}

TEST_F(ThumbnailTest, HeightOf255RowsIsTheMost) {
    setUpEngine();
    EXPECT_EQ(get(3, 1, 255).returned, "byte[510]");
    const Bytes drawn = counting(255 * 64);
    for (size_t row = 0; row < 255; row++) ASSERT_EQ(bytes[row * 2], drawn[row * 64]) << row;
}

TEST_F(ThumbnailTest, BufferIsZeroedBeforeTheEngineDraws) {
    setUpPlayer();
    Bytes before;
    engine->drawThumbnail = [&](_Media_Thumbnail_Info_T* thumbnail) {
        before.assign(thumbnail->pBuffer, thumbnail->pBuffer + thumbnail->u4BufferSize);
    };
    auto dirty = mallocCall.replace([](size_t size) {
        void* block = mallocCall.real(size);
        memset(block, 0x5a, size);
        return block;
    });
    get(12, 3, 2);
    EXPECT_EQ(before, Bytes(128, 0));
}

struct ModeCase {
    int mode;
    int bytesPerPixel;
};
void PrintTo(const ModeCase& one, std::ostream* out) { *out << one.mode; }

class ThumbnailModeTest : public ThumbnailTest, public testing::WithParamInterface<ModeCase> {};

TEST_P(ThumbnailModeTest, HasItsBytesPerPixel) {
    const auto [mode, pixel] = GetParam();
    setUpEngine();
    const Outcome outcome = get(mode, 8, 2);
    if (pixel == 0) {
        std::vector<ExpectedLine> lines = linesTo(mode, 8, 2);
        lines.push_back(kModeNotUsed);
        EXPECT_THAT(outcome, Returns("null").logs(lines));
        return;
    }
    EXPECT_EQ(outcome.returned, "byte[" + std::to_string(16 * pixel) + "]");
    EXPECT_EQ(engine->receivedThumbnails.at(0).u4BufferSize, 128u);
    EXPECT_THAT(outcome.log, testing::Contains(LineIs(widthLine(64 / pixel))));
}

INSTANTIATE_TEST_SUITE_P(Modes, ThumbnailModeTest,
                         testing::Values(ModeCase{0, 0}, ModeCase{1, 0}, ModeCase{2, 0},
                                         ModeCase{3, 2}, ModeCase{4, 2}, ModeCase{5, 4},
                                         ModeCase{6, 0}, ModeCase{7, 0}, ModeCase{8, 0},
                                         ModeCase{9, 2}, ModeCase{10, 2}, ModeCase{11, 2},
                                         ModeCase{12, 4}, ModeCase{13, 0}, ModeCase{14, 0},
                                         ModeCase{15, 2}, ModeCase{16, 2}, ModeCase{17, 4},
                                         ModeCase{18, 4}, ModeCase{19, 0}, ModeCase{1000, 0},
                                         ModeCase{-1, 0}, ModeCase{-2147483647 - 1, 0}));

TEST_F(ThumbnailTest, NoHeightOrWidthIsNoThumbnail) {
    setUpEngine();
    const auto watch = mallocCall.replace([](size_t size) {
        EXPECT_NE(size, 0u) << "a block that nobody frees";
        return mallocCall.real(size);
    });
    std::vector<ExpectedLine> lines = linesTo(5, 10, 0);
    lines.insert(lines.end(), {widthLine(16), kModeNotUsed});
    EXPECT_THAT(get(5, 10, 0), Returns("null").logs(lines));
    lines = linesTo(5, 0, 10);
    lines.insert(lines.end(), {widthLine(0), kModeNotUsed});
    EXPECT_THAT(get(5, 0, 10), Returns("null").logs(lines));
}

// 256 MB a row, 128 rows: eight times what 32 bits can say.
TEST_F(ThumbnailTest, MoreBytesThanARequestCanSayAreOutOfMemory) {
    setUpEngine();
    std::vector<ExpectedLine> lines = linesTo(5, 0x4000000, 128);
    lines.insert(lines.end(), {widthLine(0x4000000), kNoMemory});
    EXPECT_THAT(get(5, 0x4000000, 128), Returns("null").logs(lines));
    // Those of which 32 bits would leave few.
    EXPECT_EQ(get(5, 0x2000001, 128).returned, "null");
    EXPECT_EQ(get(5, 16, -1).returned, "null");
}

TEST_F(ThumbnailTest, MissingService) {
    EXPECT_THAT(get(5, 10, 2),
                Returns("null")
                    .logs({enter("OrvMediaClient_getThumbnailInfo"),
                           bridgeError("service not exist, throw exception. Line:%d\n")})
                    .throws(kIllegalState));
}

TEST_F(ThumbnailTest, MissingFieldNamesTheClass) {
    setUpEngine();
    for (size_t i = 3; i-- > 0;) {
        const std::string field = kFields[i];
        request->type->remove(field);
        std::vector<ExpectedLine> lines = linesTo(5, 10, 2, i);
        lines.insert(lines.end(), {info("getIntValueFromJava(): pszClassPath=" + kThumbnailInfo +
                                        ", pszVar_AliasName=" + field),
                                   error("getIntValueFromJava(): find variable(SubtitleAttr, " +
                                         field + ") failed, please check\n"),
                                   bridgeError("OrvMediaCliengetThumbnailInfo(): get " + field +
                                               ", " + kThumbnailInfo + ", error happen\n")});
        EXPECT_THAT(get(5, 10, 2),
                    Returns("null").logs(lines).throws("java/lang/NoSuchFieldError", field));
    }
}

// Follows one block of that size from malloc to free.
class BlockWatch {
public:
    explicit BlockWatch(size_t size)
        : mAllocated(mallocCall,
                     [this, size](size_t bytes) {
                         void* block = mallocCall.real(bytes);
                         if (bytes == size && mBlock == nullptr) mBlock = block;
                         return block;
                     }),
          mFreed(freeCall, [this](void* block) {
              if (block != nullptr && block == mBlock) frees++;
              freeCall.real(block);
          }) {}

    int frees = 0;

private:
    void* mBlock = nullptr;
    PosixCall<void*(size_t)>::Replacement mAllocated;
    PosixCall<void(void*)>::Replacement mFreed;
};

TEST_F(ThumbnailTest, EnginesRefusalFreesTheBuffer) {
    setUpEngine().answer("getThumbnailInfo", {0});
    std::vector<ExpectedLine> lines = linesTo(5, 10, 200);
    lines.insert(lines.end(),
                 {widthLine(16), service,
                  bridgeInfo("OrvMediaCliengetThumbnailInfo(): GetThumbNail() failed")});
    BlockWatch watch(12800);
    EXPECT_THAT(get(5, 10, 200),
                Returns("null").logs(lines).engine({"getThumbnailInfo(12800, 5, 10, 200)"}));
    EXPECT_EQ(watch.frees, 1);
}

TEST_F(ThumbnailTest, SuccessFreesTheBuffer) {
    setUpEngine();
    BlockWatch watch(12800);
    EXPECT_EQ(get(5, 10, 200).returned, "byte[8000]");
    EXPECT_EQ(watch.frees, 1);
}

TEST_F(ThumbnailTest, FailedArrayFreesTheBuffer) {
    setUpEngine();
    vm.fail("NewByteArray");
    BlockWatch watch(12800);
    const Outcome outcome = get(5, 10, 200);
    EXPECT_EQ(outcome.returned, "null");
    EXPECT_EQ(outcome.thrown->type, kOutOfMemory);
    EXPECT_EQ(watch.frees, 1);
}

TEST_F(ThumbnailTest, OutOfMemory) {
    setUpEngine();
    std::vector<ExpectedLine> lines = linesTo(5, 10, 200);
    lines.insert(lines.end(), {widthLine(16), kNoMemory});
    auto failure = mallocCall.replace(
        [](size_t size) { return size == 12800 ? nullptr : mallocCall.real(size); });
    EXPECT_THAT(get(5, 10, 200), Returns("null").logs(lines));
}

class EmbeddedPictureTest : public JniFixture {
protected:
    Outcome get() {
        return observe("native_getEmbeddedPicture", [&] {
            auto result = fakejni::callNative<jbyteArray>(
                vm, playerClass, vm.local(player), "native_getEmbeddedPicture", "(I)[B", jint{3});
            if (result.value.object != nullptr) bytes = result.value.object->bytes;
            return result;
        });
    }

    Bytes bytes;
    const ExpectedLine entered = bridgeInfo("getEmbeddedPicture(): Enter\n");
    const ExpectedLine left = bridgeInfo("getEmbeddedPicture(): Leave\n");
    const ExpectedLine service = serviceInfo("OrvMediaService::extractAlbumArt()");
};

TEST_F(EmbeddedPictureTest, IsTheEnginesBytesAndItsBlockIsFreed) {
    setUpPlayer().albumArt = counting(1000);
    BlockWatch watch(sizeof(MediaAlbumArt) + 1000);
    EXPECT_THAT(get(),
                Returns("byte[1000]").logs({entered, service, left}).engine({"extractAlbumArt()"}));
    EXPECT_EQ(bytes, counting(1000));
    EXPECT_EQ(watch.frees, 1);
}

TEST_F(EmbeddedPictureTest, EmptyPictureIsAnEmptyArray) {
    setUpPlayer().albumArt = Bytes();
    EXPECT_THAT(get(),
                Returns("byte[0]").logs({entered, service, left}).engine({"extractAlbumArt()"}));
}

TEST_F(EmbeddedPictureTest, NoPictureIsNull) {
    setUpPlayer();
    EXPECT_THAT(get(), Returns("null")
                           .logs({entered, service,
                                  bridgeInfo("getEmbeddedPicture(): return NULL, leave\n")})
                           .engine({"extractAlbumArt()"}));
}

TEST_F(EmbeddedPictureTest, MissingServiceIsReportedUnderAnotherName) {
    EXPECT_THAT(
        get(),
        Returns("null")
            .logs({entered,
                   bridgeError("OrvMediaClient_prepare(): service not exist, throw exception\n")})
            .throws(kIllegalState));
}

TEST_F(EmbeddedPictureTest, FailedArrayIsLoggedAndTheBlockFreed) {
    setUpPlayer().albumArt = counting(1000);
    vm.fail("NewByteArray");
    BlockWatch watch(sizeof(MediaAlbumArt) + 1000);
    const Outcome outcome = get();
    EXPECT_EQ(outcome.returned, "null");
    EXPECT_EQ(outcome.thrown->type, kOutOfMemory);
    EXPECT_THAT(outcome.log,
                LinesAre({entered, service,
                          bridgeError("getEmbeddedPicture: OutOfMemoryError is thrown."), left}));
    EXPECT_EQ(watch.frees, 1);
}

TEST_F(EmbeddedPictureTest, ArrayThatCannotBePinnedIsReturnedUnfilled) {
    setUpPlayer().albumArt = counting(4);
    vm.fail("GetByteArrayElements");
    BlockWatch watch(sizeof(MediaAlbumArt) + 4);
    const Outcome outcome = get();
    EXPECT_EQ(outcome.returned, "byte[4]");
    EXPECT_EQ(bytes, Bytes(4, 0));
    EXPECT_THAT(outcome.log, LinesAre({entered, service, left}));
    EXPECT_EQ(watch.frees, 1);
}

}  // namespace
}  // namespace orvtest
