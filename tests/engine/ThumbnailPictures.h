// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <string>
#include <vector>

#include "inspect/Thumbnailer.h"

// Thumbnails and what the ffmpeg command makes of the same media, both as packed
// rows of bytes B, G, R and A.
namespace orvtest {

// Fails the test when there is none.
std::unique_ptr<orvtarn::Thumbnailer> openThumbnailer(const std::string& name);

std::vector<uint8_t> thumbnailAt(orvtarn::Thumbnailer& thumbnailer, int64_t positionMs, int width,
                                 int height);

// The first frame at or after a time that ffmpeg comes to when it decodes all of
// the file, through these filters and scaled.
std::vector<uint8_t> decodedAt(const std::string& name, double seconds, const std::string& filters,
                               int width, int height);

// In dB; a picture that another decoder or scaler made differs by no more.
constexpr double kSamePicture = 30;

// In dB over the three colours; 100 for equal pictures.
double psnr(const std::vector<uint8_t>& one, const std::vector<uint8_t>& other);

}  // namespace orvtest
