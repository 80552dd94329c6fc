// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

#include "core/HardwareDecoder.h"

namespace orvtarn {
namespace {

// A folder of devices.
class HardwareDecoderTest : public testing::Test {
protected:
    HardwareDecoderTest() { std::filesystem::create_directories(devices); }
    ~HardwareDecoderTest() override { std::filesystem::remove_all(devices); }

    void add(const std::string& name) {
        const std::filesystem::path path = devices / name;
        std::filesystem::create_directories(path.parent_path());
        std::ofstream(path) << "";
    }

    const std::filesystem::path devices =
        testing::TempDir() + "orv-devices-" + std::to_string(getpid());
};

TEST_F(HardwareDecoderTest, IsNoneWithoutADevice) {
    EXPECT_STREQ("no", hardwareDecoder(devices));
    add("dri/card0");  // shows pictures, decodes none
    EXPECT_STREQ("no", hardwareDecoder(devices));
    EXPECT_STREQ("no", hardwareDecoder(devices / "missing"));
}

TEST_F(HardwareDecoderTest, IsVaapiWithARenderNode) {
    add("dri/renderD129");
    EXPECT_STREQ("vaapi-copy", hardwareDecoder(devices));
}

TEST_F(HardwareDecoderTest, IsNvdecWithItsDriver) {
    add("dri/renderD128");
    add("nvidiactl");
    EXPECT_STREQ("nvdec-copy", hardwareDecoder(devices));
}

TEST(DirectDecoderTest, CopiesNothingAndHasItsInterop) {
    EXPECT_EQ("vaapi", directDecoder("vaapi-copy"));
    EXPECT_STREQ("vaapi", decoderInterop("vaapi-copy"));
    EXPECT_EQ("nvdec", directDecoder("nvdec-copy"));
    EXPECT_STREQ("cuda", decoderInterop("nvdec-copy"));
    EXPECT_EQ("no", directDecoder("no"));
    EXPECT_STREQ("no", decoderInterop("no"));
}

}  // namespace
}  // namespace orvtarn
