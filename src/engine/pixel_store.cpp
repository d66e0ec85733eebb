#include "engine/pixel_store.h"

#include "engine/blend.h"

#include <algorithm>
#include <new>

#if defined(__linux__)
#include <sys/mman.h>
#endif

namespace {

constexpr std::size_t kHugePage = std::size_t{2} << 20;  // bytes

}  // namespace

void PixelStore::resize(std::int32_t width, std::int32_t height, std::int32_t margin) {
    stride_ = margin + wholeCacheLines(width) + wholeCacheLines(margin + kBlendOverreach);
    const std::size_t pixels = static_cast<std::size_t>(stride_) * static_cast<std::size_t>(height);
    const std::size_t bytes = (pixels * sizeof(std::uint32_t) + kHugePage - 1) / kHugePage * kHugePage;
    pixels_.reset(static_cast<std::uint32_t*>(std::aligned_alloc(kHugePage, bytes)));
    if (!pixels_) throw std::bad_alloc();
#if defined(__linux__)
    // A bulb's rows lie in pages of their own; large pages spare their look-up. A refusal costs only speed.
    static_cast<void>(madvise(pixels_.get(), bytes, MADV_HUGEPAGE));
#endif
    std::fill_n(pixels_.get(), pixels, 0xFF000000U);
    first_ = pixels_.get() + margin;
}

void PixelStore::load(const QImage& picture) {
    const QImage opaque = picture.convertToFormat(QImage::Format_RGB32);
    for (std::int32_t y = 0; y < opaque.height(); ++y) {
        const auto* from = reinterpret_cast<const std::uint32_t*>(opaque.constScanLine(y));
        std::transform(from, from + opaque.width(), row(y), [](std::uint32_t pixel) { return pixel | 0xFF000000U; });
    }
}
