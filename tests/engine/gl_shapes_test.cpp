#include "engine/gl_shapes.h"
#include "tests/support/masks.h"

namespace {

const ZephGLShapes& shapes() {
    return masks().GLShapes;
}

std::int32_t doubleArea(const ShapeVertex& a, const ShapeVertex& b, const ShapeVertex& c) {
    return (b.X - a.X) * (c.Y - a.Y) - (b.Y - a.Y) * (c.X - a.X);
}

// What the triangles cover, doubled; -1 where one is turned over or flat.
std::int32_t doubleArea(const GLFill& fill) {
    std::int32_t sum = 0;
    for (std::size_t t = 0; t + 2 < fill.Triangles.size(); t += 3) {
        const std::int32_t area = doubleArea(fill.Corners[fill.Triangles[t]], fill.Corners[fill.Triangles[t + 1]],
                                             fill.Corners[fill.Triangles[t + 2]]);
        if (area <= 0) return -1;
        sum += area;
    }
    return sum;
}

// Of a closed outline; the sign tells its direction.
template <typename Outline>
std::int32_t outlineArea(const Outline& outline, std::size_t count) {
    std::int32_t sum = 0;
    for (std::size_t i = 0; i + 1 < count; ++i)
        sum += outline[i].X * outline[i + 1].Y - outline[i].Y * outline[i + 1].X;
    return sum;
}

}  // namespace

TEST(GLShapes, PutsTheCirclePointsWhereTheAnglesLie) {
    // sin and cos of 20 degrees are 0.342 and 0.940, of 40: 0.643 and 0.766, of 60: 0.866 and 0.5.
    const auto& ten = shapes().ZephGLCircle[10];
    EXPECT_EQ(ten[0], (ShapeVertex{0, 10}));
    EXPECT_EQ(ten[1], (ShapeVertex{3, 9}));
    EXPECT_EQ(ten[2], (ShapeVertex{6, 8}));
    EXPECT_EQ(ten[9], (ShapeVertex{0, -10}));
    EXPECT_EQ(ten[18], ten[0]);
    // Half a pixel goes to the even neighbour on both sides, so that small circles stay symmetrical.
    const auto& one = shapes().ZephGLCircle[1];
    EXPECT_EQ(one[3], (ShapeVertex{1, 0}));
    EXPECT_EQ(one[6], (ShapeVertex{1, 0}));
    EXPECT_EQ(one[12], (ShapeVertex{-1, 0}));
    EXPECT_EQ(shapes().ZephGLCircle[64][9], (ShapeVertex{0, -64}));
    EXPECT_EQ(shapes().ZephGLCircle[0][5], (ShapeVertex{0, 0}));
}

// Triangles that all turn the same way and together are as large as the outline neither overlap nor leave holes.
TEST(GLShapes, FillsEveryOutlineOnce) {
    for (std::int32_t shape = 2; shape <= 10; ++shape) {
        const GLOutlineTable& table = shapes().Outlines[static_cast<std::size_t>(shape)];
        for (std::int32_t size = 1; size <= kMaxBulbSize; ++size) {
            const GLFill* fill = fillOf(shapes(), shape, size);
            ASSERT_NE(fill, nullptr) << shape << " of size " << size;
            EXPECT_EQ(doubleArea(*fill),
                      std::abs(outlineArea(table.Sizes[static_cast<std::size_t>(size)], table.VertexCount)))
                << shape << " of size " << size;
        }
    }
    for (std::int32_t radius = 1; radius < kCircleRadii; ++radius) {
        const GLFill* fill = fillOf(shapes(), kFloodShape, radius);
        ASSERT_NE(fill, nullptr) << radius;
        // The points run clockwise with y upward.
        EXPECT_EQ(doubleArea(*fill),
                  -outlineArea(shapes().ZephGLCircle[static_cast<std::size_t>(radius)], kCirclePoints))
            << radius;
    }
}

TEST(GLShapes, HasNoTrianglesForWhatCannotBeDrawn) {
    constexpr std::array<std::pair<std::int32_t, std::int32_t>, 10> kOdd{
        {{1, 0}, {1, 65}, {12, -1}, {11, 65}, {2, 0}, {2, 17}, {3, 64}, {0, 4}, {13, 4}, {-1, 4}}};
    for (const auto& [shape, size] : kOdd)
        EXPECT_EQ(fillOf(shapes(), shape, size), nullptr) << shape << " of size " << size;
    EXPECT_TRUE(fillPolygonByTriangles({{0, 0}, {4, 4}, {2, 2}, {0, 0}}).Triangles.empty());
    EXPECT_TRUE(fillPolygonByTriangles({}).Triangles.empty());
}
