// The libraries that a user could draw bulbs with instead, given the same images: QPainter and pixman, and a plain
// loop.
#pragma once

#include "engine/blend.h"

#include <QImage>

#include <algorithm>
#include <memory>
#include <pixman.h>
#include <vector>

// The image as a premultiplied picture.
inline QImage asPicture(const BulbImage& image) {
    const int side = 2 * image.Mask->Size;
    QImage picture(side, side, QImage::Format_ARGB32_Premultiplied);
    for (int y = 0; y < side; ++y) {
        auto* row = reinterpret_cast<std::uint32_t*>(picture.scanLine(y));
        for (int x = 0; x < side; ++x) {
            row[x] = coveredPixel(image.Color, image.Mask->Coverage[static_cast<std::size_t>(y * side + x)]);
        }
    }
    return picture;
}

struct PixmanFree {
    void operator()(pixman_image_t* image) const noexcept { pixman_image_unref(image); }
};
using PixmanImage = std::unique_ptr<pixman_image_t, PixmanFree>;

// A view of the picture, which must outlive it.
inline PixmanImage pixmanView(QImage& picture, pixman_format_code_t format) {
    return PixmanImage(pixman_image_create_bits_no_clear(format, picture.width(), picture.height(),
                                                         reinterpret_cast<std::uint32_t*>(picture.bits()),
                                                         static_cast<int>(picture.bytesPerLine())));
}

// One constant mask for each opacity 0..255.
inline std::vector<PixmanImage> pixmanOpacities() {
    std::vector<PixmanImage> opacities;
    for (std::uint32_t a = 0; a < 256; ++a) {
        const pixman_color_t color{0, 0, 0, static_cast<std::uint16_t>(a * 257)};
        opacities.emplace_back(pixman_image_create_solid_fill(&color));
    }
    return opacities;
}

// One image pixel by pixel, by the plain formula, clipped to the canvas of Format_RGB32.
inline void blendPlainly(const QImage& picture, std::uint32_t alpha, std::int32_t left, std::int32_t top,
                         QImage& canvas) {
    const std::int32_t side = picture.width();
    for (std::int32_t y = std::max(0, -top); y < std::min(side, canvas.height() - top); ++y) {
        const auto* from = reinterpret_cast<const std::uint32_t*>(picture.constScanLine(y));
        auto* to = reinterpret_cast<std::uint32_t*>(canvas.bits() + (top + y) * canvas.bytesPerLine());
        for (std::int32_t x = std::max(0, -left); x < std::min(side, canvas.width() - left); ++x) {
            to[left + x] = blendPixelReference(from[x], to[left + x], alpha);
        }
    }
}
