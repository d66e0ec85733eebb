// Pictures as the painting works on them: rows of 32-bit pixels that begin on whole cache lines, with a margin on
// either side so that a bulb cut by the canvas edge needs no clipping of columns.
#pragma once

#include "model/simulation.h"

#include <QImage>

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <memory>

inline constexpr std::int32_t kCacheLinePixels = 16;
inline constexpr std::int32_t kMarginPixels = 128;  // the largest image hangs out no farther

constexpr std::int32_t wholeCacheLines(std::int32_t pixels) noexcept {
    return (pixels + kCacheLinePixels - 1) / kCacheLinePixels * kCacheLinePixels;
}

class PixelStore {
public:
    // Opaque black, margins included. margin: pixels on either side, whole cache lines; kernels may overreach it on the
    // right. On failure an exception, as of any container.
    void resize(std::int32_t width, std::int32_t height, std::int32_t margin = kMarginPixels);
    // Opaque, from a picture of the size that the store was given.
    void load(const QImage& picture);

    std::uint32_t* row(std::int32_t y) noexcept { return first_ + y * stride_; }  // the pixel in column 0
    const std::uint32_t* row(std::int32_t y) const noexcept { return first_ + y * stride_; }
    std::int32_t stride() const noexcept { return stride_; }  // pixels, a multiple of kCacheLinePixels

private:
    struct Free {
        void operator()(std::uint32_t* pixels) const noexcept { std::free(pixels); }
    };
    std::unique_ptr<std::uint32_t[], Free> pixels_;
    std::uint32_t* first_ = nullptr;
    std::int32_t stride_ = 0;
};
