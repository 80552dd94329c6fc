// SPDX-License-Identifier: Apache-2.0
// Tracks, subtitles, pictures, descriptions and settings: what the service
// forwards.
#include "ServiceOperation.h"

namespace orvtest {
namespace {

using Service = android::OrvMediaService;
using Operation = ServiceOperation;

std::vector<Operation> tracks() {
    return {
        Operation::flag("getAudioTrackInfo", false,
                        [](Service& s) {
                            AudioTrackInfo info;
                            return s.getAudioTrackInfo(true, 6, info);
                        })
            .entry({"OrvMediaService::getAudioTrackInfo(1)"})
            .reaches({"getAudioTrackInfo(true, 6)"}),
        Operation::flag("setAudioTrack", false, [](Service& s) { return s.setAudioTrack(2); })
            .entry({"OrvMediaService::setAudioTrack(2)"})
            .reaches({"selectAudioTrack(2)"}),
        Operation::flag("getVideoCodecInfo", false,
                        [](Service& s) {
                            VideoCodecInfo info;
                            return s.getVideoCodecInfo(info);
                        }),
        Operation::flag("getVideoCodecInfo_index", false,
                        [](Service& s) {
                            VideoCodecInfo info;
                            return s.getVideoCodecInfo(3, info);
                        })
            .entry({"OrvMediaService::getVideoCodecInfo()"})
            .noPlayer({"OrvMediaService::getVideoCodecInfo(): NO_INIT"})
            .reaches({"getVideoCodecInfo(3)"}),
        Operation::flag("getVideoTrackCount", false,
                        [](Service& s, int& out) { return s.getVideoTrackCount(out); }),
        Operation::flag("getAudioTrackCount", false,
                        [](Service& s, int& out) { return s.getAudioTrackCount(out); }),
        Operation::status("getCurrentAudioIndex",
                          [](Service& s, int& out) { return s.getCurrentAudioIndex(&out); })
            .entry({"OrvMediaService::getCurrentAudioIndex(): occur"}),
        Operation::flag("selectTrack", false, [](Service& s) { return s.selectTrack(4); })
            .entry({"OrvMediaService::setSubtitleTrack(4)"})
            .noPlayer({"OrvMediaService::setSubtitleTrack(): NO_INIT"})
            .reaches({"selectTrack(4)"}),
        Operation::flag("deselectTrack", false, [](Service& s) { return s.deselectTrack(4); })
            .reaches({"deselectTrack(4)"}),
    };
}

std::vector<Operation> subtitles() {
    return {
        Operation::flag("onSubtitleTrack", false, [](Service& s) { return s.onSubtitleTrack(1); })
            .reaches({"onSubtitleTrack(1)"}),
        Operation::flag("offSubtitleTrack", false, [](Service& s) { return s.offSubtitleTrack(); }),
        Operation::flag("getSubtitleTrackInfo", false,
                        [](Service& s) {
                            SubtitleTrackInfo info;
                            return s.getSubtitleTrackInfo(8, info);
                        })
            .entry({"OrvMediaService::getSubtitleTrackInfo(8)"})
            .reaches({"getSubtitleTrackInfo(8)"}),
        Operation::flag("getSubtitleTrackCount", false,
                        [](Service& s, int& out) { return s.getSubtitleTrackCount(out); }),
        Operation::status("getCurrentSubtitleIndex",
                          [](Service& s, int& out) { return s.getCurrentSubtitleIndex(&out); })
            .entry({"OrvMediaService::getCurrentSubtitleIndex(): occur"}),
        Operation::flag("setSubtitleDataSource", false,
                        [](Service& s) { return s.setSubtitleDataSource("/m/a.srt"); })
            .entry({"OrvMediaService::setSubtitleDataSource()",
                    "OrvMediaService::setSubtitleDataSource(): url=/m/a.srt"})
            .reaches({"setSubtitleDataSource(/m/a.srt)"}),
        Operation::flag("setSubtitleDataSourceEx", false,
                        [](Service& s) { return s.setSubtitleDataSourceEx("/a.sub", "/a.idx"); })
            .entry({"OrvMediaService::setSubtitleDataSource(): occur"})
            .reaches({"setSubtitleDataSourceEx(/a.sub, /a.idx)"}),
        Operation::flag("setSubtitleDataSourceEx_nulls", false,
                        [](Service& s) { return s.setSubtitleDataSourceEx(nullptr, nullptr); })
            .entry({"OrvMediaService::setSubtitleDataSource(): occur"})
            .noPlayer({"OrvMediaService::setSubtitleDataSourceEx(): NO_INIT"})
            .reaches({"setSubtitleDataSourceEx(null, null)"}),
        Operation::flag("setSubtitleAttr", false,
                        [](Service& s) {
                            Subtitle_Color color;
                            color.mA = 0x80;
                            color.mB = 3;
                            return s.setSubtitleAttr(E_SUBTITLE_ATTR_TYPE_BG_COLOR, &color);
                        })
            .reaches({"setSubtitleAttr(3, 128, 0, 0, 3)"}),
        Operation::flag("flushSubtitleAttr", false,
                        [](Service& s) { return s.flushSubtitleAttr(); })
            .entry({"OrvMediaService::flushSubtltAttr()"})
            .noPlayer({"OrvMediaService::flushSubtltAttr(): NO_INIT"}),
    };
}

Operation setPlayerRole() {
    Operation operation = Operation::status("setPlayerRole", [](Service& s) {
                              return s.setPlayerRole(E_ORV_PLAYER_ROLE_SUB);
                          }).reaches({"setPlayerRole(1)"});
    operation.noPlayerResultDefined = false;
    return operation;
}

std::vector<Operation> descriptionsAndSettings() {
    return {
        Operation::flag("getMetaDataInfo", false,
                        [](Service& s) {
                            MetaDataInfo info;
                            return s.getMetaDataInfo(info);
                        }),
        Operation::flag("getThumbnailInfo", true,
                        [](Service& s) {
                            _Media_Thumbnail_Info_T request = {nullptr, 64, 5, 16, 1};
                            return s.getThumbnailInfo(&request);
                        })
            .entry({"OrvMediaService::getthumbnailinfo in"})
            .noPlayer({"OrvMediaService::getthumbnailinfo(): pThumbnaiInfo"})
            .reaches({"getThumbnailInfo(64, 5, 16, 1)"}),
        Operation::flag("extractAlbumArt", false,
                        [](Service& s) { return s.extractAlbumArt() != nullptr; })
            .gives({{0, 0}}),
        Operation::flag("setPCMMediaInfo", false,
                        [](Service& s) {
                            IORV_PB_CTRL_SET_MEDIA_INFO_T info = {};
                            return s.setPCMMediaInfo(&info);
                        })
            .gives({{0, true}, {-22, false}, {1, false}}),
        Operation::status("setPcmFlag",
                          [](Service& s) {
                              s.setPcmFlag();
                              return 0;
                          })
            .entry({"OrvMediaService::ifMP3Media()"})
            .noPlayer({"OrvMediaService::setPCMMediaInfo(): NO_INIT"})
            .noPlayerGives(0)
            .gives({{0, 0}}),
        Operation::status("setUnLockPin", [](Service& s) { return s.setUnLockPin(1234); })
            .entry({"OrvMediaService::setUnLockPin(): occur"})
            .reaches({"setUnLockPin(1234)"}),
        setPlayerRole(),
        Operation::status("setAudioStreamType", [](Service& s) { return s.setAudioStreamType(4); })
            .answersItself(android::NO_ERROR),
        Operation::status("setAuxEffectSendLevel",
                          [](Service& s) { return s.setAuxEffectSendLevel(0.5f); })
            .entry({"OrvMediaService::setAuxEffectSendLevel(0.500000), not implement"})
            .noPlayer({})
            .noPlayerGives(android::NO_ERROR)
            .answersItself(android::NO_ERROR),
        Operation::status("attachAuxEffect", [](Service& s) { return s.attachAuxEffect(11); })
            .entry({"OrvMediaService::attachAuxEffect(11), not implement"})
            .noPlayer({})
            .noPlayerGives(android::NO_ERROR)
            .answersItself(android::NO_ERROR),
        Operation::flag("ServiceSendCliCommand", true,
                        [](Service& s) {
                            unsigned char command[] = "rm.off";
                            return s.ServiceSendCliCommand(command, sizeof(command) - 1);
                        })
            .entry({"OrvMediaService::mString(rm.off)"})
            .noPlayer({})
            .answersItself(true),
    };
}

INSTANTIATE_TEST_SUITE_P(Tracks, ServiceOperationTest, testing::ValuesIn(tracks()),
                         operationTestName);
INSTANTIATE_TEST_SUITE_P(Subtitles, ServiceOperationTest, testing::ValuesIn(subtitles()),
                         operationTestName);
INSTANTIATE_TEST_SUITE_P(DescriptionsAndSettings, ServiceOperationTest,
                         testing::ValuesIn(descriptionsAndSettings()), operationTestName);

}  // namespace
}  // namespace orvtest
