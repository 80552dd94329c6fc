// SPDX-License-Identifier: Apache-2.0
#include "inspect/PictureCanvas.h"

#include <orvtarn/PlayerTypes.h>
#include <string.h>

#include <memory>

#include "inspect/FilterGraph.h"
#include "inspect/StreamPicture.h"

extern "C" {
#include <libavutil/frame.h>
#include <libavutil/imgutils.h>
#include <libavutil/pixdesc.h>
#include <libswscale/swscale.h>
}

namespace orvtarn {

using android::BAD_VALUE;
using android::OK;
using android::status_t;

namespace {

const int32_t kMaxSize = 16384;
const int kRowAlignment = 64;

struct Canvas {
    int32_t colorMode;
    AVPixelFormat format;
    int bytesPerPixel;
};

// The formats of libswscale leave the bits of an X undefined.
const Canvas kCanvases[] = {
    {ORV_COLOR_MODE_RGB565, AV_PIX_FMT_RGB565, 2},
    {ORV_COLOR_MODE_ARGB1555, AV_PIX_FMT_RGB555, 2},  // X1 R5 G5 B5
    {ORV_COLOR_MODE_ARGB8888, AV_PIX_FMT_BGRA, 4},
    {ORV_COLOR_MODE_UYVY422, AV_PIX_FMT_UYVY422, 2},
    {ORV_COLOR_MODE_YUYV422, AV_PIX_FMT_YUYV422, 2},
    {ORV_COLOR_MODE_ARGB4444, AV_PIX_FMT_RGB444, 2},  // X4 R4 G4 B4
    {ORV_COLOR_MODE_RGBA8888, AV_PIX_FMT_RGBA, 4},
    {ORV_COLOR_MODE_BGR565, AV_PIX_FMT_BGR565, 2},
    {ORV_COLOR_MODE_GRAY16, AV_PIX_FMT_GRAY16, 2},
    {ORV_COLOR_MODE_ABGR8888, AV_PIX_FMT_ABGR, 4},
    {ORV_COLOR_MODE_XRGB8888, AV_PIX_FMT_BGR0, 4},  // B8 G8 R8 X8
};

const Canvas* canvasOf(int32_t colorMode) {
    for (const Canvas& canvas : kCanvases) {
        if (canvas.colorMode == colorMode) return &canvas;
    }
    return nullptr;
}

struct FreeScaler {
    void operator()(SwsContext* scaler) const { sws_freeContext(scaler); }
};
typedef std::unique_ptr<SwsContext, FreeScaler> Scaler;

// Rows have room behind them, where scalers may write.
Frame newFrame(AVPixelFormat format, int width, int height) {
    Frame frame(av_frame_alloc());
    if (frame == nullptr) return nullptr;
    frame->format = format;
    frame->width = width;
    frame->height = height;
    return av_frame_get_buffer(frame.get(), 0) < 0 ? nullptr : std::move(frame);
}

const AVPixFmtDescriptor& knownFormatOf(const AVFrame& frame) {
    return *av_pix_fmt_desc_get(static_cast<AVPixelFormat>(frame.format));
}

bool hasAlpha(const AVFrame& frame) {
    return (knownFormatOf(frame).flags & AV_PIX_FMT_FLAG_ALPHA) != 0;
}

bool isFullRange(const AVFrame& frame) {
    return frame.color_range == AVCOL_RANGE_JPEG ||
           strncmp(knownFormatOf(frame).name, "yuvj", 4) == 0;
}

// Between RGB formats libswscale takes a way through YUV, and back by the same.
const int* coefficientsOf(const AVFrame& frame) {
    const AVColorSpace matrix = matrixOf(frame);
    return sws_getCoefficients(matrix == AVCOL_SPC_RGB ? SWS_CS_ITU601 : matrix);
}

// Gray is full range; YUV is BT.601 in limited range.
void setColors(SwsContext* scaler, const AVFrame& from, const AVFrame& to) {
    const int one = 1 << 16;
    sws_setColorspaceDetails(scaler, coefficientsOf(from), isFullRange(from),
                             sws_getCoefficients(SWS_CS_ITU601), to.format == AV_PIX_FMT_GRAY16, 0,
                             one, one);
}

Frame convert(const AVFrame& from, AVPixelFormat format, int width, int height) {
    Frame to = newFrame(format, width, height);
    if (to == nullptr) return nullptr;
    const int flags = SWS_BICUBIC | SWS_ACCURATE_RND;
    const Scaler scaler(sws_getContext(from.width, from.height,
                                       static_cast<AVPixelFormat>(from.format), width, height,
                                       format, flags, nullptr, nullptr, nullptr));
    if (scaler == nullptr) return nullptr;
    setColors(scaler.get(), from, *to);
    const int rows =
        sws_scale(scaler.get(), from.data, from.linesize, 0, from.height, to->data, to->linesize);
    return rows == height ? std::move(to) : nullptr;
}

uint32_t* pixelAt(const AVFrame& frame, int x, int y) {
    return reinterpret_cast<uint32_t*>(frame.data[0] + ptrdiff_t{y} * frame.linesize[0]) + x;
}

uint16_t withAlpha(uint16_t pixel, int32_t colorMode, uint8_t alpha) {
    if (colorMode == ORV_COLOR_MODE_ARGB1555) {
        return static_cast<uint16_t>((pixel & 0x7FFF) | (alpha >> 7) << 15);
    }
    return static_cast<uint16_t>((pixel & 0x0FFF) | (alpha * 15 + 127) / 255 << 12);
}

// Sets the bits that the scaler leaves undefined. alpha is a BGRA picture of
// the same size, or null for an opaque one.
void setAlpha(AVFrame& picture, int32_t colorMode, const AVFrame* alpha) {
    for (int y = 0; y < picture.height; y++) {
        uint8_t* row = picture.data[0] + ptrdiff_t{y} * picture.linesize[0];
        for (int x = 0; x < picture.width; x++) {
            if (colorMode == ORV_COLOR_MODE_XRGB8888) {
                row[4 * x + 3] = 255;
                continue;
            }
            const uint8_t value =
                alpha == nullptr ? 255 : reinterpret_cast<uint8_t*>(pixelAt(*alpha, x, y))[3];
            uint16_t& pixel = reinterpret_cast<uint16_t*>(row)[x];
            pixel = withAlpha(pixel, colorMode, value);
        }
    }
}

bool hasUndefinedBits(int32_t colorMode) {
    return colorMode == ORV_COLOR_MODE_ARGB1555 || colorMode == ORV_COLOR_MODE_ARGB4444 ||
           colorMode == ORV_COLOR_MODE_XRGB8888;
}

Frame picture(const AVFrame& frame, const Canvas& canvas, int width, int height) {
    Frame drawn = convert(frame, canvas.format, width, height);
    if (drawn == nullptr || !hasUndefinedBits(canvas.colorMode)) return drawn;
    Frame alpha;
    if (hasAlpha(frame) && canvas.colorMode != ORV_COLOR_MODE_XRGB8888) {
        alpha = convert(frame, AV_PIX_FMT_BGRA, width, height);
        if (alpha == nullptr) return nullptr;
    }
    setAlpha(*drawn, canvas.colorMode, alpha.get());
    return drawn;
}

}  // namespace

int bytesPerPixel(int32_t colorMode) {
    const Canvas* canvas = canvasOf(colorMode);
    return canvas == nullptr ? 0 : canvas->bytesPerPixel;
}

size_t thumbnailStride(int32_t colorMode, int32_t width) {
    const size_t bytes = static_cast<size_t>(bytesPerPixel(colorMode)) * width;
    return (bytes + kRowAlignment - 1) / kRowAlignment * kRowAlignment;
}

status_t checkThumbnail(const _Media_Thumbnail_Info_T& thumbnail) {
    const auto isSize = [](int32_t size) { return size >= 1 && size <= kMaxSize; };
    if (bytesPerPixel(thumbnail.i4CanvasColormode) == 0 || thumbnail.pBuffer == nullptr ||
        !isSize(thumbnail.i4Width) || !isSize(thumbnail.i4Height)) {
        return BAD_VALUE;
    }
    const uint64_t stride = thumbnailStride(thumbnail.i4CanvasColormode, thumbnail.i4Width);
    return stride * thumbnail.i4Height > thumbnail.u4BufferSize ? BAD_VALUE : OK;
}

status_t drawPicture(const AVFrame& frame, const _Media_Thumbnail_Info_T& thumbnail) {
    const Canvas& canvas = *canvasOf(thumbnail.i4CanvasColormode);
    const Frame drawn = picture(frame, canvas, thumbnail.i4Width, thumbnail.i4Height);
    if (drawn == nullptr) return ORV_ERROR_UNSUPPORTED;
    av_image_copy_plane(thumbnail.pBuffer,
                        static_cast<int>(thumbnailStride(canvas.colorMode, thumbnail.i4Width)),
                        drawn->data[0], drawn->linesize[0],
                        canvas.bytesPerPixel * thumbnail.i4Width, thumbnail.i4Height);
    return OK;
}

}  // namespace orvtarn
