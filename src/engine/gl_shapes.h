// The shapes of bulbs for the OpenGL output: outlines by size, and the triangles that fill them. A bulb is always a
// flat polygon here; a flood is a hard disc. Made once at start-up. Coordinates are pixels, y downward.
#pragma once

#include "engine/bulb_shapes.h"
#include "model/simulation.h"

#include <array>
#include <cstdint>
#include <vector>

inline constexpr std::int32_t kCircleRadii = kMaxFloodSize + 1;  // 0..64
inline constexpr std::int32_t kCirclePoints = 19;                // 20 degrees apart; the last is the first again
inline constexpr std::int32_t kFloodShape = 12;                  // stands for a flood, after the bulb types
inline constexpr std::int32_t kRoundShape = 1;
inline constexpr std::int32_t kPixelShape = 11;

// One polygon at sizes 1..16, in the bulb's box of twice its size. Its first vertex stands once more at the end.
struct GLOutlineTable {
    std::size_t VertexCount = 0;  // the closing vertex included; 0 = a round shape
    std::array<std::array<ShapeVertex, kMaxShapeVertices + 1>, kMaxBulbSize + 1> Sizes{};  // [size]
};

// A shape at one size as triangles.
struct GLFill {
    std::vector<ShapeVertex> Corners;     // from the centre of the bulb
    std::vector<std::uint8_t> Triangles;  // three numbers into Corners each, from 0; no two triangles overlap
};

struct ZephGLShapes {
    std::array<std::array<ShapeVertex, kCirclePoints>, kCircleRadii> ZephGLCircle{};   // [radius], from the centre
    std::array<GLOutlineTable, kBulbShapes + 1> Outlines{};                            // [shape], 1..11
    std::array<GLFill, kCircleRadii> CircleFills{};                                    // [radius]
    std::array<std::array<GLFill, kMaxBulbSize + 1>, kBulbShapes + 1> OutlineFills{};  // [shape][size]
};

// Fills all tables: circle, stars, square, triangle, pentagon, hexagon, octagon.
void ZephGLCreateShapes(ZephGLShapes& shapes);

// The shape that a fixture's bulbs are drawn in: its BulbShape, or kFloodShape.
std::int32_t shapeDrawn(const ZephFixture& fixture) noexcept;

// The triangles of a bulb. Round shapes (1, 11, 12): sizes 1..64; the others 1..16. nullptr where a damaged file has
// another size or shape, and before ZephGLCreateShapes: nothing is drawn then.
const GLFill* fillOf(const ZephGLShapes& shapes, std::int32_t shape, std::int32_t size) noexcept;

// Parts a simple polygon, in either direction, into triangles by cutting off its ears. Vertices that lie on a straight
// line, or twice in one place, are left out. A polygon without area gives nothing.
GLFill fillPolygonByTriangles(std::vector<ShapeVertex> outline);
