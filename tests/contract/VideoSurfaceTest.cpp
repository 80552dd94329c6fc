// SPDX-License-Identifier: Apache-2.0
#include "JniFixture.h"
#include "jni/VideoSurface.h"

namespace orvtest {
namespace {

using android::sp;
using android::Surface;

constexpr char kMissingLine[] = "service not exist, throw exception. Line:%d\n";

class VideoSurfaceTest : public JniFixture {
protected:
    void SetUp() override {
        JniFixture::SetUp();
        producer = new TestProducer;
        surface = new Surface(producer);
    }

    Outcome set(const fakejni::ObjectPtr& javaSurface) {
        jobject handle = vm.local(javaSurface);
        return call<void>("native_setVideoSurface", "(Landroid/view/Surface;)V", handle);
    }
    jlong field() { return player->get("mNativeSurfaceTexture").integer; }
    static jlong addressOf(const sp<TestProducer>& object) {
        android::IGraphicBufferProducer* base = object.get();
        return static_cast<jlong>(reinterpret_cast<uintptr_t>(base));
    }
    static std::string bound(const sp<TestProducer>& object) {
        android::IGraphicBufferProducer* base = object.get();
        return "setVideoSurfaceTexture(" + pointerText(base) + ")";
    }
    // The lines of a binding; rest follows the dropping of the old producer.
    static std::vector<ExpectedLine> lines(const std::vector<ExpectedLine>& rest) {
        std::vector<ExpectedLine> all = {enter("OrvMediaClient_setVideoSurface"),
                                         enter("setVideoSurface"), enter("decVideoSurfaceRef"),
                                         leave("decVideoSurfaceRef")};
        all.insert(all.end(), rest.begin(), rest.end());
        all.push_back(leave("OrvMediaClient_setVideoSurface"));
        return all;
    }
    static std::vector<ExpectedLine> wholeBinding() {
        return lines(
            {serviceInfo("OrvMediaService::setVideoSurfaceTexture()"), leave("setVideoSurface")});
    }

    // Strong references: one of this fixture, one of the surface.
    sp<TestProducer> producer;
    sp<Surface> surface;
};

TEST_F(VideoSurfaceTest, BindingHandsTheProducerOnAndKeepsOneReference) {
    setUpPlayer();
    EXPECT_THAT(set(newJavaSurface(vm, surface)),
                ReturnsNothing().logs(wholeBinding()).engine({bound(producer)}));
    EXPECT_EQ(field(), addressOf(producer));
    EXPECT_EQ(producer->getStrongCount(), 3);
}

// First the reference, then the field, then the service. The count is that of
// the fixture, the surface, the Java object and the call itself.
TEST_F(VideoSurfaceTest, ReferenceIsTakenBeforeTheAddressIsWrittenAndHandedOn) {
    setUpPlayer();
    std::vector<std::string> steps;
    const auto step = [&](const std::string& name) {
        EXPECT_EQ(producer->getStrongCount(), 4) << name;
        EXPECT_EQ(field(), name == "written" ? 0 : addressOf(producer)) << name;
        steps.push_back(name);
    };
    vm.whenCalled("SetLongField", [&] { step("written"); });
    engine->whenCalled("setVideoSurfaceTexture", [&] { step("handed on"); });
    set(newJavaSurface(vm, surface));
    EXPECT_THAT(steps, testing::ElementsAre("written", "handed on"));
    vm.whenCalled("SetLongField", [] {});
}

TEST_F(VideoSurfaceTest, BindingTwiceStillKeepsOneReference) {
    setUpPlayer();
    set(newJavaSurface(vm, surface));
    EXPECT_THAT(set(newJavaSurface(vm, surface)),
                ReturnsNothing().logs(wholeBinding()).engine({bound(producer)}));
    EXPECT_EQ(producer->getStrongCount(), 3);
}

TEST_F(VideoSurfaceTest, BindingAnotherSurfaceGivesTheFirstBack) {
    setUpPlayer();
    set(newJavaSurface(vm, surface));
    const sp<TestProducer> other = new TestProducer;
    const sp<Surface> otherSurface = new Surface(other);
    set(newJavaSurface(vm, otherSurface));
    EXPECT_EQ(field(), addressOf(other));
    EXPECT_EQ(producer->getStrongCount(), 2);
    EXPECT_EQ(other->getStrongCount(), 3);
}

TEST_F(VideoSurfaceTest, NullSurfaceClearsTheField) {
    setUpPlayer();
    set(newJavaSurface(vm, surface));
    EXPECT_THAT(set(nullptr),
                ReturnsNothing().logs(wholeBinding()).engine({"setVideoSurfaceTexture(null)"}));
    EXPECT_EQ(field(), 0);
    EXPECT_EQ(producer->getStrongCount(), 2);
}

TEST_F(VideoSurfaceTest, RefusalByTheEngineIsIgnored) {
    setUpPlayer().answer("setVideoSurfaceTexture", {-38});
    EXPECT_THAT(set(newJavaSurface(vm, surface)),
                ReturnsNothing().logs(wholeBinding()).engine({bound(producer)}));
    EXPECT_EQ(field(), addressOf(producer));
}

TEST_F(VideoSurfaceTest, ReleasedSurfaceThrowsAfterThePreviousLostItsReference) {
    setUpPlayer();
    set(newJavaSurface(vm, surface));
    EXPECT_THAT(
        set(newJavaSurface(vm, nullptr)),
        ReturnsNothing()
            .logs(lines({bridgeError("setVideoSurface(): surface==null, throw exception\n")}))
            .throws(kIllegalArgument, "The surface has been released"));
    EXPECT_EQ(field(), addressOf(producer));
    EXPECT_EQ(producer->getStrongCount(), 2);

    // The stale field's reference may not be dropped again at the end.
    player->set("mNativeSurfaceTexture", fakejni::Value::ofLong(0));
}

TEST_F(VideoSurfaceTest, SurfaceWithoutProducerThrows) {
    setUpPlayer();
    const sp<Surface> empty = new Surface(nullptr);
    EXPECT_THAT(
        set(newJavaSurface(vm, empty)),
        ReturnsNothing()
            .logs(lines({bridgeError("setVideoSurface(): new_st==null, throw exception\n")}))
            .throws(kIllegalArgument, "The surface does not have a binding SurfaceTexture!"));
    EXPECT_EQ(field(), 0);
}

// The address that a failed binding leaves costs a reference once more, at the
// next binding alone.
TEST_F(VideoSurfaceTest, StaleAddressIsDroppedOnceByTheNextBinding) {
    setUpPlayer();
    set(newJavaSurface(vm, surface));
    set(newJavaSurface(vm, new Surface(nullptr)));
    EXPECT_EQ(field(), addressOf(producer));
    EXPECT_EQ(producer->getStrongCount(), 2);
    producer->incStrong(this);  // the one that it costs
    for (int round = 0; round < 2; round++) {
        EXPECT_THAT(set(nullptr),
                    ReturnsNothing().logs(wholeBinding()).engine({"setVideoSurfaceTexture(null)"}));
        EXPECT_EQ(field(), 0);
        EXPECT_EQ(producer->getStrongCount(), 2);
    }
    call<void>("native_release", "()V");
    EXPECT_EQ(producer->getStrongCount(), 2);
}

TEST_F(VideoSurfaceTest, MissingServiceIsLoggedTwiceAndThrows) {
    const Outcome outcome = set(newJavaSurface(vm, surface));
    EXPECT_THAT(outcome,
                ReturnsNothing()
                    .logs({enter("OrvMediaClient_setVideoSurface"), enter("setVideoSurface"),
                           bridgeError(kMissingLine), bridgeError(kMissingLine),
                           leave("OrvMediaClient_setVideoSurface")})
                    .throws(kIllegalState));
    const std::vector<int> numbers = lineNumbers(outcome.log);
    EXPECT_NE(numbers[0], numbers[1]);
    EXPECT_EQ(producer->getStrongCount(), 2);
}

TEST_F(VideoSurfaceTest, MissingServiceIsLoggedOnceWhenThePlayerNeedNotLive) {
    jobject thiz = vm.local(player);
    EXPECT_THAT(observeAction([&] { android::setVideoSurface(vm.env(), thiz, nullptr, false); }),
                ReturnsNothing().logs({enter("setVideoSurface"), bridgeError(kMissingLine)}));
}

TEST_F(VideoSurfaceTest, DroppingTheReferenceLeavesTheField) {
    setUpPlayer();
    set(newJavaSurface(vm, surface));
    jobject thiz = vm.local(player);
    EXPECT_THAT(observeAction([&] { android::decVideoSurfaceRef(vm.env(), thiz); }),
                ReturnsNothing().logs({enter("decVideoSurfaceRef"), leave("decVideoSurfaceRef")}));
    EXPECT_EQ(field(), addressOf(producer));
    EXPECT_EQ(producer->getStrongCount(), 2);
    player->set("mNativeSurfaceTexture", fakejni::Value::ofLong(0));
}

TEST_F(VideoSurfaceTest, DroppingWithoutServiceOnlyLogsEnter) {
    producer->incStrong(this);
    player->set("mNativeSurfaceTexture", fakejni::Value::ofLong(addressOf(producer)));
    jobject thiz = vm.local(player);
    EXPECT_THAT(observeAction([&] { android::decVideoSurfaceRef(vm.env(), thiz); }),
                ReturnsNothing().logs({enter("decVideoSurfaceRef")}));
    EXPECT_EQ(producer->getStrongCount(), 3);
    producer->decStrong(this);
}

TEST_F(VideoSurfaceTest, ReleaseDropsTheReferenceAndLeavesTheStaleAddress) {
    setUpPlayer();
    set(newJavaSurface(vm, surface));
    call<void>("native_release", "()V");
    EXPECT_EQ(field(), addressOf(producer));
    EXPECT_EQ(producer->getStrongCount(), 2);
    call<void>("native_release", "()V");
    EXPECT_EQ(producer->getStrongCount(), 2);
}

TEST_F(VideoSurfaceTest, PrepareHandsTheProducerOnAgain) {
    setUpPlayer();
    set(newJavaSurface(vm, surface));
    EXPECT_THAT(call<void>("native_prepare", "()V").engine,
                testing::ElementsAre(bound(producer), "prepare()"));
    EXPECT_EQ(producer->getStrongCount(), 3);
}

TEST_F(VideoSurfaceTest, BoundProducerIsReadSilently) {
    jobject thiz = vm.local(player);
    EXPECT_EQ(android::getVideoSurfaceTexture(vm.env(), thiz), nullptr);
    setUpPlayer();
    set(newJavaSurface(vm, surface));
    sp<android::IGraphicBufferProducer> read;
    EXPECT_THAT(observeAction([&] { read = android::getVideoSurfaceTexture(vm.env(), thiz); }),
                ReturnsNothing());
    EXPECT_EQ(read.get(), producer.get());
}

}  // namespace
}  // namespace orvtest
