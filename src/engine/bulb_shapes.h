// The outlines of the bulb shapes: nine polygons on a grid of 0..32, scaled to each bulb size. The masks are cut from
// them and the OpenGL output fills them. Coordinates are pixels within the bulb's box, which is twice its size.
#pragma once

#include "model/tables.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>

struct ShapeVertex {
    std::int32_t X = 0;
    std::int32_t Y = 0;
    bool operator==(const ShapeVertex&) const = default;
};

inline constexpr std::size_t kMaxShapeVertices = 16;
inline constexpr std::int32_t kShapeGrid = 32;

// One shape at all sizes.
struct BulbShapeTable {
    std::size_t VertexCount = 0;
    std::array<std::array<ShapeVertex, kMaxShapeVertices>, kMaxBulbSize> Sizes{};  // [size - 1]

    // size 1..16.
    constexpr std::span<const ShapeVertex> at(std::int32_t size) const noexcept {
        return {Sizes[static_cast<std::size_t>(size - 1)].data(), VertexCount};
    }
};

namespace bulb_shapes_detail {
// Int(2 x size / 32 x g): the scale is exact in binary, so whole numbers give the same.
template <std::size_t N>
constexpr BulbShapeTable scaled(const ShapeVertex (&grid)[N]) noexcept {
    static_assert(N <= kMaxShapeVertices);
    BulbShapeTable table;
    table.VertexCount = N;
    for (std::int32_t size = 1; size <= kMaxBulbSize; ++size) {
        for (std::size_t v = 0; v < N; ++v) {
            table.Sizes[static_cast<std::size_t>(size - 1)][v] = {2 * size * grid[v].X / kShapeGrid,
                                                                  2 * size * grid[v].Y / kShapeGrid};
        }
    }
    return table;
}
}  // namespace bulb_shapes_detail

// Apexes stand at 15 where the middle of the grid is 16, and the right-hand points of stars a step lower than the
// left-hand ones: displays in the field are laid out with bulbs that look so.
// clang-format off
constexpr BulbShapeTable CreateTriangles() noexcept {
    return bulb_shapes_detail::scaled({{15, 0}, {32, 32}, {0, 32}});
}
constexpr BulbShapeTable CreateSquares() noexcept {
    return bulb_shapes_detail::scaled({{0, 0}, {32, 0}, {32, 32}, {0, 32}});
}
constexpr BulbShapeTable CreatePentagons() noexcept {
    return bulb_shapes_detail::scaled({{15, 0}, {32, 13}, {26, 32}, {6, 32}, {0, 13}});
}
constexpr BulbShapeTable CreateHexagons() noexcept {
    return bulb_shapes_detail::scaled({{7, 0}, {24, 0}, {32, 16}, {24, 32}, {7, 32}, {0, 16}});
}
constexpr BulbShapeTable CreateOctagons() noexcept {
    return bulb_shapes_detail::scaled({{8, 0}, {23, 0}, {32, 9}, {32, 23}, {23, 32}, {8, 32}, {0, 23}, {0, 9}});
}
constexpr BulbShapeTable CreateFourPointStars() noexcept {
    return bulb_shapes_detail::scaled({{15, 0}, {17, 14}, {32, 16}, {17, 17}, {15, 32}, {13, 17}, {0, 15}, {14, 14}});
}
constexpr BulbShapeTable CreateFivePointStars() noexcept {
    return bulb_shapes_detail::scaled({{15, 0}, {20, 12}, {32, 12}, {22, 20}, {25, 32},
                                       {15, 24}, {6, 32}, {9, 20}, {0, 12}, {12, 12}});
}
constexpr BulbShapeTable CreateSixPointStars() noexcept {
    return bulb_shapes_detail::scaled({{15, 0}, {20, 9}, {32, 7}, {24, 16}, {32, 24}, {20, 22},
                                       {15, 32}, {11, 22}, {0, 24}, {7, 16}, {0, 7}, {11, 9}});
}
constexpr BulbShapeTable CreateEightPointStars() noexcept {
    return bulb_shapes_detail::scaled({{9, 0}, {15, 7}, {22, 0}, {22, 10}, {32, 10}, {24, 16}, {32, 22}, {22, 22},
                                       {22, 32}, {15, 24}, {9, 32}, {9, 22}, {0, 22}, {7, 16}, {0, 9}, {9, 9}});
}
// clang-format on

inline constexpr BulbShapeTable ZephTriangles = CreateTriangles();
inline constexpr BulbShapeTable ZephSquares = CreateSquares();
inline constexpr BulbShapeTable ZephPentagons = CreatePentagons();
inline constexpr BulbShapeTable ZephHexagons = CreateHexagons();
inline constexpr BulbShapeTable ZephOctagons = CreateOctagons();
inline constexpr BulbShapeTable ZephStarFour = CreateFourPointStars();
inline constexpr BulbShapeTable ZephStarFive = CreateFivePointStars();
inline constexpr BulbShapeTable ZephStarSix = CreateSixPointStars();
inline constexpr BulbShapeTable ZephStarEight = CreateEightPointStars();

enum class BulbOutline { Ellipse, Rectangle, Polygon };

// Row of the bulb type table -> how it is drawn. Table is null for an ellipse.
struct BulbShapeRow {
    BulbOutline Outline;
    const BulbShapeTable* Table;
};
inline constexpr std::array<BulbShapeRow, kBulbShapes> kBulbShapeRows{{
    {BulbOutline::Ellipse, nullptr},         // Round
    {BulbOutline::Polygon, &ZephTriangles},  // Triangle
    {BulbOutline::Rectangle, &ZephSquares},  // Square
    {BulbOutline::Polygon, &ZephPentagons},  // Pentagon
    {BulbOutline::Polygon, &ZephHexagons},   // Hexagon
    {BulbOutline::Polygon, &ZephOctagons},   // Octagon
    {BulbOutline::Polygon, &ZephStarFour},   // 4 Point Star
    {BulbOutline::Polygon, &ZephStarFive},   // 5 Point Star
    {BulbOutline::Polygon, &ZephStarSix},    // 6 Point Star
    {BulbOutline::Polygon, &ZephStarEight},  // 8 Point Star
    {BulbOutline::Ellipse, nullptr},         // Pixel Bulb
}};
