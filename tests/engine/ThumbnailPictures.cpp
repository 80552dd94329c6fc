// SPDX-License-Identifier: Apache-2.0
#include "ThumbnailPictures.h"

#include <gtest/gtest.h>

#include <cmath>

#include "TestMedia.h"
#include "inspect/PictureCanvas.h"

namespace orvtest {

std::unique_ptr<orvtarn::Thumbnailer> openThumbnailer(const std::string& name) {
    std::unique_ptr<orvtarn::Thumbnailer> thumbnailer;
    EXPECT_EQ(orvtarn::Thumbnailer::create(openMedia(name), -1, thumbnailer), 0) << name;
    return thumbnailer;
}

std::vector<uint8_t> thumbnailAt(orvtarn::Thumbnailer& thumbnailer, int64_t positionMs, int width,
                                 int height) {
    const size_t stride = orvtarn::thumbnailStride(ORV_COLOR_MODE_ARGB8888, width);
    std::vector<uint8_t> buffer(stride * height);
    EXPECT_EQ(thumbnailer.draw(positionMs, {buffer.data(), static_cast<uint32_t>(buffer.size()),
                                            ORV_COLOR_MODE_ARGB8888, width, height}),
              0);
    std::vector<uint8_t> packed;
    for (int y = 0; y < height; y++) {
        packed.insert(packed.end(), &buffer[y * stride], &buffer[y * stride] + 4 * width);
    }
    return packed;
}

std::vector<uint8_t> decodedAt(const std::string& name, double seconds, const std::string& filters,
                               int width, int height) {
    const std::string select = "select=gte(t\\," + std::to_string(seconds - 0.001) + ")";
    const std::string scale = "scale=" + std::to_string(width) + ":" + std::to_string(height) +
                              ":flags=bicubic+accurate_rnd,format=bgra";
    const std::string graph = (filters.empty() ? "" : filters + ",") + select + "," + scale;
    std::vector<uint8_t> pixels =
        outputOf("ffmpeg -nostdin -v fatal -noautorotate -i '" + mediaPath(name) +
                 "' -map 0:v:0 -vsync passthrough -frames:v 1 -vf '" + graph + "' -f rawvideo -");
    EXPECT_EQ(pixels.size(), static_cast<size_t>(width) * height * 4) << name << " at " << seconds;
    return pixels;
}

double psnr(const std::vector<uint8_t>& one, const std::vector<uint8_t>& other) {
    EXPECT_EQ(one.size(), other.size());
    if (one.empty() || one.size() != other.size()) return 0;
    double sum = 0;
    for (size_t i = 0; i < one.size(); i++) {
        const double difference = i % 4 == 3 ? 0 : (one[i] - other[i]) / 255.0;
        sum += difference * difference;
    }
    const double mean = sum / (static_cast<double>(one.size()) * 3 / 4);
    return mean == 0 ? 100 : -10 * std::log10(mean);
}

}  // namespace orvtest
