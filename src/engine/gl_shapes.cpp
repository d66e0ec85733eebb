#include "engine/gl_shapes.h"

#include "util/rounding.h"

#include <algorithm>
#include <numbers>

namespace {

constexpr std::int32_t kStepDeg = 20;

// Sine of a whole multiple of 20 degrees, through the first quadrant: it must not depend on the last bit of a library's
// sine whether half a pixel is rounded up or down, and a circle must come out symmetrical.
double sineOf(std::int32_t degrees) {
    degrees %= 360;
    if (degrees >= 180) return -sineOf(degrees - 180);
    if (degrees > 90) degrees = 180 - degrees;
    return degrees == 30 ? 0.5 : std::sin(degrees * std::numbers::pi / 180);
}

void createCircles(ZephGLShapes& shapes) {
    for (std::int32_t r = 0; r < kCircleRadii; ++r) {
        auto& circle = shapes.ZephGLCircle[static_cast<std::size_t>(r)];
        for (std::int32_t j = 0; j < kCirclePoints; ++j) {
            circle[static_cast<std::size_t>(j)] = {roundHalfEven(r * sineOf(j * kStepDeg)),
                                                   roundHalfEven(r * sineOf(j * kStepDeg + 90))};
        }
        shapes.CircleFills[static_cast<std::size_t>(r)] = fillPolygonByTriangles({circle.begin(), circle.end() - 1});
    }
}

void createOutlines(std::int32_t shape, const BulbShapeTable& table, ZephGLShapes& shapes) {
    GLOutlineTable& outlines = shapes.Outlines[static_cast<std::size_t>(shape)];
    outlines.VertexCount = table.VertexCount + 1;
    for (std::int32_t size = 1; size <= kMaxBulbSize; ++size) {
        const std::span<const ShapeVertex> vertices = table.at(size);
        auto& outline = outlines.Sizes[static_cast<std::size_t>(size)];
        std::ranges::copy(vertices, outline.begin());
        outline[vertices.size()] = vertices.front();

        std::vector<ShapeVertex> centred(vertices.begin(), vertices.end());
        for (ShapeVertex& vertex : centred)
            vertex = {vertex.X - size, vertex.Y - size};
        shapes.OutlineFills[static_cast<std::size_t>(shape)][static_cast<std::size_t>(size)] =
            fillPolygonByTriangles(std::move(centred));
    }
}

// Twice the area of the triangle; above 0 where c lies to the left of the way from a to b, with y upward.
std::int32_t turn(const ShapeVertex& a, const ShapeVertex& b, const ShapeVertex& c) noexcept {
    return (b.X - a.X) * (c.Y - a.Y) - (b.Y - a.Y) * (c.X - a.X);
}

// Leaves only vertices at which the outline turns.
void dropStraight(std::vector<ShapeVertex>& outline) {
    for (std::size_t i = 0; i < outline.size() && outline.size() >= 3;) {
        const std::size_t n = outline.size();
        if (turn(outline[(i + n - 1) % n], outline[i], outline[(i + 1) % n]) == 0) {
            outline.erase(outline.begin() + static_cast<std::ptrdiff_t>(i));
            i = 0;  // its neighbours may have become straight
        } else {
            ++i;
        }
    }
}

std::int32_t doubleArea(const std::vector<ShapeVertex>& outline) noexcept {
    std::int32_t sum = 0;
    for (std::size_t i = 0; i < outline.size(); ++i) {
        const ShapeVertex& next = outline[(i + 1) % outline.size()];
        sum += outline[i].X * next.Y - outline[i].Y * next.X;
    }
    return sum;
}

// Whether the corner at position i of the remaining outline can be cut off: it bulges outward and nothing else of the
// outline lies in its triangle.
bool isEar(const std::vector<ShapeVertex>& corners, const std::vector<std::uint8_t>& left, std::size_t i) {
    const std::size_t n = left.size();
    const ShapeVertex& a = corners[left[(i + n - 1) % n]];
    const ShapeVertex& b = corners[left[i]];
    const ShapeVertex& c = corners[left[(i + 1) % n]];
    if (turn(a, b, c) <= 0) return false;
    return std::ranges::none_of(left, [&](std::uint8_t other) {
        const ShapeVertex& p = corners[other];
        if (p == a || p == b || p == c) return false;
        return turn(a, b, p) >= 0 && turn(b, c, p) >= 0 && turn(c, a, p) >= 0;
    });
}

}  // namespace

GLFill fillPolygonByTriangles(std::vector<ShapeVertex> outline) {
    dropStraight(outline);
    if (outline.size() < 3) return {};
    if (doubleArea(outline) < 0) std::ranges::reverse(outline);

    GLFill fill;
    fill.Corners = std::move(outline);
    std::vector<std::uint8_t> left(fill.Corners.size());
    for (std::size_t i = 0; i < left.size(); ++i)
        left[i] = static_cast<std::uint8_t>(i);
    while (left.size() >= 3) {
        std::size_t ear = 0;
        while (ear < left.size() && !isEar(fill.Corners, left, ear))
            ++ear;
        if (ear == left.size()) break;  // only flat corners are left over
        const std::size_t n = left.size();
        fill.Triangles.insert(fill.Triangles.end(), {left[(ear + n - 1) % n], left[ear], left[(ear + 1) % n]});
        left.erase(left.begin() + static_cast<std::ptrdiff_t>(ear));
    }
    return fill;
}

void ZephGLCreateShapes(ZephGLShapes& shapes) {
    constexpr std::array<std::int32_t, 9> kOrder{7, 8, 9, 10, 3, 2, 4, 5, 6};  // stars, square, triangle and upward
    createCircles(shapes);
    for (const std::int32_t shape : kOrder)
        createOutlines(shape, *kBulbShapeRows[static_cast<std::size_t>(shape - 1)].Table, shapes);
}

std::int32_t shapeDrawn(const ZephFixture& fixture) noexcept {
    return fixture.Fixture_Type == kFixtureFlood ? kFloodShape : fixture.BulbShape;
}

const GLFill* fillOf(const ZephGLShapes& shapes, std::int32_t shape, std::int32_t size) noexcept {
    const GLFill* fill = nullptr;
    if (shape == kRoundShape || shape == kPixelShape || shape == kFloodShape) {
        if (size >= 1 && size < kCircleRadii) fill = &shapes.CircleFills[static_cast<std::size_t>(size)];
    } else if (shape >= 1 && shape <= kBulbShapes && size >= 1 && size <= kMaxBulbSize) {
        fill = &shapes.OutlineFills[static_cast<std::size_t>(shape)][static_cast<std::size_t>(size)];
    }
    return fill != nullptr && !fill->Triangles.empty() ? fill : nullptr;
}
