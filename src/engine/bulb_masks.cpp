#include "engine/bulb_masks.h"

#include "engine/bulb_shapes.h"
#include "engine/hard_raster.h"
#include "util/rounding.h"

#include <algorithm>
#include <string>

namespace {

constexpr std::uint8_t kCovered = 255;
constexpr double kPixelsPerRing = 2.3;  // of a flood's radius

BulbMask emptyMask(std::int32_t size, bool soft) {
    BulbMask mask;
    mask.Size = size;
    mask.Soft = soft;
    mask.Coverage.assign(static_cast<std::size_t>(4 * size * size), 0);
    mask.Stride = !soft && size <= 2 ? 4 : (2 * size + 7) / 8 * 8;
    return mask;
}

// The forms that the blend kernels read, made from the coverage.
void finishMask(BulbMask& mask) {
    const std::int32_t side = 2 * mask.Size;
    if (!mask.Soft) mask.Lanes.assign(static_cast<std::size_t>(side * mask.Stride), 0);
    for (std::int32_t y = 0; y < side; ++y) {
        const std::uint8_t* row = mask.Coverage.data() + y * side;
        std::int32_t first = side;
        std::int32_t end = 0;
        for (std::int32_t x = 0; x < side; ++x) {
            if (row[x] == 0) continue;
            first = std::min(first, x);
            end = x + 1;
            if (!mask.Soft) mask.Lanes[static_cast<std::size_t>(y * mask.Stride + x)] = 0xFFFFFFFFU;
        }
        mask.Blocks.push_back(
            first < end ? MaskBlocks{static_cast<std::uint8_t>(first / 8), static_cast<std::uint8_t>((end + 7) / 8)}
                        : MaskBlocks{});
    }
}

}  // namespace

void ZephSetUpMasks(const ZephDimmingCurve& curve, const MaskProgress& progress, ZephMasks& masks) {
    SetUpNormalMasks(progress, masks);
    SetUpFloodMasks(curve, progress, masks);
    ZephGLCreateShapes(masks.GLShapes);
}

void SetUpNormalMasks(const MaskProgress& progress, ZephMasks& masks) {
    for (std::int32_t shape = 1; shape <= kBulbShapes; ++shape) {
        progress("Creating Bulb Masks - " + std::string(ZephBulbType(shape).Name));
        const BulbShapeRow& row = kBulbShapeRows[static_cast<std::size_t>(shape - 1)];
        for (std::int32_t size = 1; size <= kMaxBulbSize; ++size) {
            BulbMask mask = emptyMask(size, false);
            const ByteSquare square{mask.Coverage.data(), 2 * size};
            switch (row.Outline) {
            case BulbOutline::Ellipse:
                fillEllipse(0, 0, 2 * size, 2 * size, kCovered, square);
                break;
            case BulbOutline::Rectangle:
                std::fill(mask.Coverage.begin(), mask.Coverage.end(), kCovered);
                break;
            case BulbOutline::Polygon:
                fillPolygon(row.Table->at(size), kCovered, square);
                break;
            }
            finishMask(mask);
            masks.ZephBulbMasks[size][shape] = std::move(mask);
        }
    }
}

void SetUpFloodMasks(const ZephDimmingCurve& curve, const MaskProgress& progress, ZephMasks& masks) {
    for (std::int32_t size = 1; size <= kMaxFloodSize; ++size) {
        progress("Creating Bulb Masks - Flood size:" + std::to_string(size));
        BulbMask mask = emptyMask(size, true);
        const ByteSquare square{mask.Coverage.data(), 2 * size};
        const std::int32_t step = roundHalfEven(255 / (size / kPixelsPerRing));
        // Size 1 comes to no ring at all: such a flood has always been invisible, and displays count on it.
        const std::int32_t rings = roundHalfEven(size / kPixelsPerRing);
        for (std::int32_t k = 1; k <= rings; ++k) {
            const std::uint8_t grey = curve[static_cast<std::size_t>(clampByte(k * step))];
            const std::int32_t low = 2 * k - 2;
            const std::int32_t high = 2 * (size - k) + 2;
            fillEllipse(low, low, high, high, grey, square);
        }
        masks.ZephFloodMasks[size] = std::move(mask);
    }
    for (std::int32_t size = 1; size <= kMaxFloodSize; ++size) {
        progress("Buffering Bulb Masks - Flood size:" + std::to_string(size));
        finishMask(masks.ZephFloodMasks[size]);
    }
}

const BulbMask* maskOf(const ZephMasks& masks, const ZephFixture& fixture) noexcept {
    const BulbMask* mask = nullptr;
    if (fixture.Fixture_Type == kFixtureFlood) {
        if (masks.ZephFloodMasks.contains(fixture.BulbSize)) mask = &masks.ZephFloodMasks[fixture.BulbSize];
    } else if (fixture.BulbSize >= 1 && fixture.BulbSize <= kMaxBulbSize && fixture.BulbShape >= 1 &&
               fixture.BulbShape <= kBulbShapes) {
        mask = &masks.ZephBulbMasks[fixture.BulbSize][fixture.BulbShape];
    }
    return mask != nullptr && mask->Size > 0 ? mask : nullptr;
}
