// SPDX-License-Identifier: Apache-2.0
#include "base/PictureFilters.h"

#include <math.h>
#include <stdint.h>
#include <stdio.h>

#include <algorithm>
#include <vector>

namespace orvtarn {
namespace {

// Reference white of HDR video, in cd/m² (Report ITU-R BT.2408): it becomes the
// white of the standard range.
constexpr double kReferenceWhite = 203;
// What HLG is made for, and PQ without metadata is taken as.
constexpr double kUsualPeak = 1000;
constexpr double kGreatestPeak = 10000;  // of PQ

// The numbers of ITU-T H.273 that zscale has, which are those of libavutil.
AVColorSpace matrixOr(AVColorSpace matrix, AVColorSpace missing) {
    switch (matrix) {
        case AVCOL_SPC_UNSPECIFIED:
        case AVCOL_SPC_RESERVED:
        case AVCOL_SPC_SMPTE2085:
            return missing;
        default:
            return matrix >= AVCOL_SPC_NB ? missing : matrix;
    }
}

AVColorPrimaries primariesOr(AVColorPrimaries primaries, AVColorPrimaries missing) {
    const bool isKnown = (primaries >= AVCOL_PRI_BT709 && primaries <= AVCOL_PRI_SMPTE432 &&
                          primaries != AVCOL_PRI_UNSPECIFIED && primaries != AVCOL_PRI_RESERVED) ||
                         primaries == AVCOL_PRI_EBU3213;
    return isKnown ? primaries : missing;
}

// Light beyond the reference white is compressed, the darker part stays as it is.
std::string toneMapping(const PictureTraits& traits) {
    const bool isPq = traits.transfer == AVCOL_TRC_SMPTE2084;
    const double known = isPq && traits.peakLuminance > 0 ? traits.peakLuminance : kUsualPeak;
    const double peak = std::clamp(known, kReferenceWhite, kGreatestPeak) / kReferenceWhite;
    char text[320];
    snprintf(text, sizeof(text),
             "zscale=tin=%d:pin=%d:min=%d:rin=%s:t=linear:npl=%.0f:p=bt709,"
             "tonemap=mobius:desat=0:peak=%.4f,"
             "zscale=tin=linear:pin=bt709:t=bt709:p=bt709:m=bt709:r=limited,format=yuv444p",
             static_cast<int>(traits.transfer),
             static_cast<int>(primariesOr(traits.primaries, AVCOL_PRI_BT2020)),
             static_cast<int>(matrixOr(traits.matrix, AVCOL_SPC_BT2020_NCL)),
             traits.range == AVCOL_RANGE_JPEG ? "full" : "limited", kReferenceWhite, peak);
    return text;
}

// zscale takes no half pixels of chroma.
bool hasHalfChroma(const PictureTraits& traits) {
    return (traits.width % 2 != 0 || traits.height % 2 != 0) && traits.matrix != AVCOL_SPC_RGB;
}

std::vector<const char*> turning(const Orientation& orientation) {
    const bool isMirrored = orientation.isMirrored;
    switch (orientation.rotation) {
        case 90:
            return {isMirrored ? "transpose=cclock_flip" : "transpose=clock"};
        case 180:
            return isMirrored ? std::vector<const char*>{"vflip"}
                              : std::vector<const char*>{"hflip", "vflip"};
        case 270:
            return {isMirrored ? "transpose=clock_flip" : "transpose=cclock"};
        default:
            return isMirrored ? std::vector<const char*>{"hflip"} : std::vector<const char*>{};
    }
}

}  // namespace

// x' = m[0] x + m[3] y, y' = m[1] x + m[4] y.
Orientation orientationOf(const int32_t* displayMatrix) {
    if (displayMatrix == nullptr) return {};
    const double x = displayMatrix[0];
    const double y = displayMatrix[1];
    const double determinant = x * displayMatrix[4] - y * displayMatrix[3];
    if (determinant == 0) return {};
    const bool isMirrored = determinant < 0;
    const double clockwise = atan2(y, isMirrored ? -x : x);
    const int quarters = static_cast<int>(lround(clockwise / M_PI_2));
    return {(quarters + 4) % 4 * 90, isMirrored};
}

bool isHighDynamicRange(const PictureTraits& traits) {
    return traits.transfer == AVCOL_TRC_SMPTE2084 || traits.transfer == AVCOL_TRC_ARIB_STD_B67;
}

std::string pictureFilters(const PictureTraits& traits) {
    std::vector<std::string> filters;
    // A frame for a frame; those that are not marked as interlaced pass.
    if (traits.isInterlaced) filters.emplace_back("bwdif=mode=send_frame:deint=interlaced");
    if (isHighDynamicRange(traits)) {
        if (hasHalfChroma(traits)) filters.emplace_back("format=yuv444p16");
        filters.push_back(toneMapping(traits));
    }
    for (const char* filter : turning(traits.orientation)) filters.emplace_back(filter);
    std::string graph;
    for (const std::string& filter : filters) graph += (graph.empty() ? "" : ",") + filter;
    return graph;
}

}  // namespace orvtarn
