// The coverage of every bulb: one mask for each size and shape, and one soft disc for each flood size. Made once at
// start-up, before any bulb image, and kept for the program's life: images point at them.
#pragma once

#include "engine/gl_shapes.h"
#include "model/dimming_curve.h"
#include "model/tables.h"
#include "util/one_based.h"

#include <array>
#include <cstdint>
#include <functional>
#include <string_view>
#include <vector>

// The part of a row that is not empty, in blocks of eight pixels.
struct MaskBlocks {
    std::uint8_t First = 0;
    std::uint8_t End = 0;  // one past the last; First == End = an empty row
    bool operator==(const MaskBlocks&) const = default;
};

struct BulbMask {
    std::int32_t Size = 0;               // the bulb's radius; the mask is 2 x Size pixels square
    bool Soft = false;                   // coverage between 0 and 255 occurs: a flood
    std::vector<std::uint8_t> Coverage;  // 0..255, row by row

    // For the blend kernels: rows of Stride pixels, a multiple of eight (four up to size 2), filled up with nothing.
    std::int32_t Stride = 0;
    std::vector<std::uint32_t> Lanes;  // hard masks only: all bits set where covered
    std::vector<MaskBlocks> Blocks;    // one a row

    bool operator==(const BulbMask&) const = default;
};

struct ZephMasks {
    OneBased<OneBased<BulbMask, kBulbShapes>, kMaxBulbSize> ZephBulbMasks;  // [size][shape]
    OneBased<BulbMask, kMaxFloodSize> ZephFloodMasks;                       // [size]
    ZephGLShapes GLShapes;                                                  // what OpenGL draws in place of masks
};

// Shown on the start-up screen as the work goes on.
using MaskProgress = std::function<void(std::string_view)>;

// All masks, and the shapes for OpenGL. The curve shapes the glow of floods and must be read before.
void ZephSetUpMasks(const ZephDimmingCurve& curve, const MaskProgress& progress, ZephMasks& masks);
void SetUpNormalMasks(const MaskProgress& progress, ZephMasks& masks);
void SetUpFloodMasks(const ZephDimmingCurve& curve, const MaskProgress& progress, ZephMasks& masks);

// The mask of a fixture's bulbs: by size for floods, by size and shape for the others. nullptr where the tables have
// none (a damaged file's size or shape, or masks not made): such bulbs are not drawn.
const BulbMask* maskOf(const ZephMasks& masks, const ZephFixture& fixture) noexcept;
