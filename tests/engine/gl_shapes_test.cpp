#include "engine/gl_shapes.h"
#include "tests/support/masks.h"

TEST(GLShapes, PutsTheCirclePointsWhereTheAnglesLie) {
    // sin and cos of 20 degrees are 0.342 and 0.940, of 40: 0.643 and 0.766, of 60: 0.866 and 0.5.
    const auto& ten = masks().GLShapes.ZephGLCircle[10];
    EXPECT_EQ(ten[0], (ShapeVertex{0, 10}));
    EXPECT_EQ(ten[1], (ShapeVertex{3, 9}));
    EXPECT_EQ(ten[2], (ShapeVertex{6, 8}));
    EXPECT_EQ(ten[9], (ShapeVertex{0, -10}));
    // Half a pixel goes to the even neighbour on both sides, so that small circles stay symmetrical.
    const auto& one = masks().GLShapes.ZephGLCircle[1];
    EXPECT_EQ(one[3], (ShapeVertex{1, 0}));
    EXPECT_EQ(one[12], (ShapeVertex{-1, 0}));
}

TEST(GLShapes, HasNoTrianglesForWhatCannotBeDrawn) {
    for (const auto& [shape, size] :
         {std::pair{1, 0}, {1, 65}, {12, -1}, {11, 65}, {2, 0}, {2, 17}, {3, 64}, {0, 4}, {13, 4}, {-1, 4}})
        EXPECT_EQ(fillOf(masks().GLShapes, shape, size), nullptr) << shape << " of size " << size;
    EXPECT_TRUE(fillPolygonByTriangles({{0, 0}, {4, 4}, {2, 2}, {0, 0}}).Triangles.empty());
    EXPECT_TRUE(fillPolygonByTriangles({}).Triangles.empty());
}
