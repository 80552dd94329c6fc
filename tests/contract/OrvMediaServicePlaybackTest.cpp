// SPDX-License-Identifier: Apache-2.0
// Data sources, playback, speed and seeks: what the service forwards.
#include <binder/Parcel.h>
#include <gui/IGraphicBufferProducer.h>
#include <media/MediaTrack.h>

#include "ServiceOperation.h"

namespace orvtest {
namespace {

using android::IStreamSource;
using android::MediaTrack;
using android::Parcel;
using Service = android::OrvMediaService;
using Operation = ServiceOperation;

// Never called by the service, so its address is all that is needed.
IOrvStreamSource* someSource() {
    static char storage[16];
    return reinterpret_cast<IOrvStreamSource*>(storage);
}

Parcel parcelOf(int32_t word) {
    Parcel parcel;
    parcel.writeInt32(word);
    parcel.setDataPosition(0);
    return parcel;
}

std::vector<Operation> dataSources() {
    return {
        Operation::status("setDataSource_url",
                          [](Service& s) { return s.setDataSource("http://x/a.ts", nullptr); })
            .entry({"OrvMediaService::setDataSource(http://x/a.ts)"})
            .noPlayer({"OrvMediaService::setDataSource(url, headers): NO_INIT"})
            .reaches({"configPlayer(false)", "setDataSource(http://x/a.ts, null)"}),
        Operation::status(
            "setDataSource_fd",
            [](Service& s) { return s.setDataSource(7, int64_t{1} << 40, int64_t{5} << 33); })
            .entry({})
            .noPlayer({"OrvMediaService::setDataSource(fd, offset, length): NO_INIT"})
            .reaches({"setDataSource(7, 1099511627776, 42949672960)"}),
        Operation::status(
            "setDataSource_IStreamSource",
            [](Service& s) { return s.setDataSource(static_cast<IStreamSource*>(nullptr)); })
            .entry({"OrvMediaService::setDataSource(): not implement"})
            .noPlayer({"OrvMediaService::setDataSource(IStreamSource): NO_INIT"})
            .answersItself(android::NO_ERROR),
        Operation::status("setDataSource_IOrvStreamSource",
                          [](Service& s) { return s.setDataSource(someSource()); })
            .entry({"OrvMediaService::setDataSource(IOrvStreamSource):"})
            .noPlayer({"OrvMediaService::setDataSource(IOrvStreamSource): NO_INIT"})
            .reaches({"setDataSource(" + pointerText(someSource()) + ")"}),
    };
}

std::vector<Operation> playback() {
    return {
        Operation::status("setVideoSurfaceTexture",
                          [](Service& s) { return s.setVideoSurfaceTexture(nullptr); })
            .reaches({"setVideoSurfaceTexture(null)"}),
        Operation::status("prepare", [](Service& s) { return s.prepare(); }),
        Operation::status("prepareAsync", [](Service& s) { return s.prepareAsync(); }),
        Operation::status("start", [](Service& s) { return s.start(); }),
        Operation::status("stop", [](Service& s) { return s.stop(); }),
        Operation::status("pause", [](Service& s) { return s.pause(); }),
        Operation::status("reset", [](Service& s) { return s.reset(); }),
        Operation::status("release", [](Service& s) { return s.release(); }),
        Operation::flag("isPlaying", true, [](Service& s) { return s.isPlaying(); }),
        Operation::status("setVolume", [](Service& s) { return s.setVolume(0.25f, 1.0f); })
            .entry({"OrvMediaService::setVolume(0.250000, 1.000000)"})
            .noPlayer({"setVolume(): NO_INIT"})
            .reaches({"setVolume(0.25, 1)"}),
        Operation::status("setParameter",
                          [](Service& s) { return s.setParameter(1400, parcelOf(9)); })
            .entry({"OrvMediaService::setParameter(1400)"})
            .noPlayer({"OrvMediaService::setParameter(int, Parcel): NO_INIT"})
            .reaches({"setParameter(1400, [9])"}),
        Operation::status("getParameter",
                          [](Service& s) {
                              Parcel reply;
                              return s.getParameter(-5, &reply);
                          })
            .entry({"OrvMediaService::getParameter(-5)"})
            .noPlayer({"OrvMediaService::getParameter(int, Parcel): NO_INIT"})
            .reaches({"getParameter(-5)"}),
        Operation::status("getCurrentPosition",
                          [](Service& s, int& out) { return s.getCurrentPosition(&out); })
            .entry({}),
        Operation::status("getCurrentBytePosition",
                          [](Service& s, int& out) { return s.getCurrentBytePosition(&out); })
            .entry({}),
        Operation::status("getVideoWidth",
                          [](Service& s, int& out) { return s.getVideoWidth(&out); })
            .entry({"OrvMediaService::getVideoWidth(): occur"}),
        Operation::status("getVideoHeight",
                          [](Service& s, int& out) { return s.getVideoHeight(&out); })
            .entry({"OrvMediaService::getVideoHeight(): occur"}),
        Operation::status(
            "seekTo",
            [](Service& s) { return s.seekTo(1000, MediaTrack::ReadOptions::SEEK_CLOSEST); })
            .entry({"OrvMediaService::seekTo(1000)"})
            .reaches({"seekTo(1000, 0)"}),
    };
}

std::vector<Operation> speedAndSteps() {
    return {
        Operation::flag("canDoSeek", true, [](Service& s) { return s.canDoSeek(-2000); })
            .entry({"OrvMediaService::canDoSeek(-2000)"})
            .reaches({"canDoSeek(-2000)"}),
        Operation::flag("canDoTrick", true, [](Service& s) { return s.canDoTrick(4000); })
            .entry({"OrvMediaService::canDoTrick(4000)"})
            .reaches({"canDoTrick(4000)"}),
        Operation::flag("setTS", true, [](Service& s) { return s.setTS(65535); })
            .entry({"OrvMediaService::setTS(65535)"})
            .reaches({"setTS(65535)"}),
        Operation::flag("step", true, [](Service& s) { return s.step(-3); })
            .entry({"OrvMediaService::step in"})
            .noPlayer({"OrvMediaService::step(): amount = -3"})
            .reaches({"step(-3)"}),
        Operation::status("setSpeed", [](Service& s) { return s.setSpeed(2000); })
            .entry({"OrvMediaService::setSpeed(2000)"})
            .noPlayerGives(android::UNKNOWN_ERROR)
            .reaches({"setSpeed(2000)"}),
        Operation::flag("getSpeed", true, [](Service& s, int& out) { return s.getSpeed(out); }),
        Operation::status("getBufferPercent", [](Service& s) { return s.getBufferPercent(); })
            .noPlayerGives(0)
            .gives({{0, 0}, {37, 37}, {100, 100}}),
        Operation::flag("seekToPosition", false, [](Service& s) { return s.seekToPosition(4096); })
            .reaches({"seekToPosition(4096)"}),
        Operation::flag("seekToPosition_negative", false,
                        [](Service& s) { return s.seekToPosition(-1); })
            .entry({"OrvMediaService::seekToPosition()"})
            .noPlayer({"OrvMediaService::seekToPosition(): NO_INIT"})
            .reaches({"seekToPosition(18446744073709551615)"}),
    };
}

INSTANTIATE_TEST_SUITE_P(DataSources, ServiceOperationTest, testing::ValuesIn(dataSources()),
                         operationTestName);
INSTANTIATE_TEST_SUITE_P(Playback, ServiceOperationTest, testing::ValuesIn(playback()),
                         operationTestName);
INSTANTIATE_TEST_SUITE_P(SpeedAndSteps, ServiceOperationTest, testing::ValuesIn(speedAndSteps()),
                         operationTestName);

}  // namespace
}  // namespace orvtest
