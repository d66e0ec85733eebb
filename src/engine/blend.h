// Blending bulbs onto 32-bit pixels (blue, green, red, alpha in memory): per channel
//   result = source x alpha / 255 + destination x (1 - sourceAlpha x alpha / 65025)
// rounded once, to the nearest, with source the image's colour times its coverage. Every form below gives the same
// pixels, the reference form by the plain formula. Called by the drawing surfaces and the editor's light drawing.
#pragma once

#include "engine/bulb_images.h"

#include <cstddef>
#include <cstdint>
#include <span>

// A bulb's image as the kernels read it. Mask is never null.
struct BulbSprite {
    const BulbMask* Mask = nullptr;
    std::uint32_t Color = 0;                // 0xFFRRGGBB
    const std::uint32_t* Pixels = nullptr;  // soft masks only
};

// The image's mask must not be null.
BulbSprite spriteOf(const BulbImage& image) noexcept;

// Where a bulb's image lies: its upper left corner, in pixels.
struct BulbPlace {
    std::int16_t X = 0;
    std::int16_t Y = 0;
};

// One bulb to paint.
struct BulbItem {
    BulbPlace Place;
    std::int32_t Unit = 0;    // whose alpha it takes
    std::int32_t Sprite = 0;  // its image
    bool operator==(const BulbItem& other) const noexcept {
        return Place.X == other.Place.X && Place.Y == other.Place.Y && Unit == other.Unit && Sprite == other.Sprite;
    }
};

// Pixels that are addressed by canvas coordinates: (x, y) stands at Origin[y * Stride + x]. Origin itself may lie
// outside the storage.
struct PixelTarget {
    std::uint32_t* Origin = nullptr;
    std::ptrdiff_t Stride = 0;  // pixels
};

struct RowRange {
    std::int32_t Top = 0;
    std::int32_t Bottom = 0;  // one past the last
};

enum class BlendForm { Reference, Portable, Avx2 };

// Kernels read and write back unchanged up to this many pixels right of an image's last column.
inline constexpr std::int32_t kBlendOverreach = 6;

// The kernels of one form.
struct BlendKernels {
    // Blends the items one after the other, the rows within the range alone. alphas: 0..255 by unit; sprites: by
    // number. All columns of an item must lie in the storage, with kBlendOverreach pixels beside them.
    void (*blendItems)(std::span<const BulbItem> items, const std::uint8_t* alphas, const BulbSprite* sprites,
                       RowRange rows, const PixelTarget& target) noexcept;
    // Copies a row of pixels past the caches. Both begin on a multiple of 32 bytes; pixels is a multiple of 16.
    void (*streamRow)(const std::uint32_t* from, std::uint32_t* to, std::int32_t pixels) noexcept;
    // To be called once after streaming, before the pixels are read.
    void (*endStreaming)() noexcept;
};

bool blendFormAvailable(BlendForm form) noexcept;  // on this processor
const BlendKernels& blendKernels(BlendForm form) noexcept;
const BlendKernels& fastestBlendKernels() noexcept;

// One bulb clipped to a canvas, of any place: (x, y) is the upper left corner of the image.
struct Canvas {
    PixelTarget Target;
    std::int32_t Width = 0;  // pixels
    std::int32_t Height = 0;
};
void blendClipped(const BulbSprite& sprite, std::uint8_t alpha, std::int64_t x, std::int64_t y,
                  const Canvas& canvas) noexcept;

// One pixel by the plain formula. source: colour times coverage, with the coverage as its alpha.
std::uint32_t blendPixelReference(std::uint32_t source, std::uint32_t destination, std::uint32_t alpha) noexcept;

// blend_avx2.cpp; the kernels run only where they are available.
bool avx2Available() noexcept;
extern const BlendKernels kAvx2Kernels;
