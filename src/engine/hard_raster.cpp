#include "engine/hard_raster.h"

#include <cstdlib>

namespace {

void put(std::int32_t x, std::int32_t y, std::uint8_t value, const ByteSquare& square) noexcept {
    if (x < 0 || y < 0 || x >= square.Side || y >= square.Side) return;
    square.Bytes[y * square.Side + x] = value;
}

// Even-odd test of a pixel that does not lie on an edge (the outline takes care of those).
bool inside(std::span<const ShapeVertex> vertices, std::int32_t x, std::int32_t y) noexcept {
    bool in = false;
    for (std::size_t i = 0, j = vertices.size() - 1; i < vertices.size(); j = i++) {
        const ShapeVertex& a = vertices[i];
        const ShapeVertex& b = vertices[j];
        if ((a.Y > y) == (b.Y > y)) continue;
        // x < a.X + (b.X - a.X) * (y - a.Y) / (b.Y - a.Y), multiplied out.
        const std::int32_t left = (x - a.X) * (b.Y - a.Y);
        const std::int32_t right = (b.X - a.X) * (y - a.Y);
        if (b.Y > a.Y ? left < right : left > right) in = !in;
    }
    return in;
}

// J. E. Bresenham, "Algorithm for computer control of a digital plotter", IBM Systems Journal 4 (1965).
void drawLine(ShapeVertex from, ShapeVertex to, std::uint8_t value, const ByteSquare& square) noexcept {
    const std::int32_t dx = std::abs(to.X - from.X);
    const std::int32_t dy = -std::abs(to.Y - from.Y);
    const std::int32_t stepX = from.X < to.X ? 1 : -1;
    const std::int32_t stepY = from.Y < to.Y ? 1 : -1;
    std::int32_t error = dx + dy;
    for (;;) {
        put(from.X, from.Y, value, square);
        if (from == to) return;
        const std::int32_t twice = 2 * error;
        if (twice >= dy) {
            error += dy;
            from.X += stepX;
        }
        if (twice <= dx) {
            error += dx;
            from.Y += stepY;
        }
    }
}

}  // namespace

void fillEllipse(std::int32_t left, std::int32_t top, std::int32_t right, std::int32_t bottom, std::uint8_t value,
                 const ByteSquare& square) noexcept {
    const std::int32_t width = right - left;
    const std::int32_t height = bottom - top;
    if (width <= 0 || height <= 0) return;
    // Distances from the middle in half pixels: odd or even with the side, and the same on either hand.
    const std::int64_t limit = static_cast<std::int64_t>(width) * width * height * height;
    for (std::int32_t y = 0; y < height; ++y) {
        const std::int64_t fromMiddle = 2 * y + 1 - height;
        const std::int64_t partY = fromMiddle * fromMiddle * width * width;
        std::int32_t first = 0;
        while (2 * first < width) {
            const std::int64_t across = 2 * first + 1 - width;
            if (across * across * height * height + partY <= limit) break;
            ++first;
        }
        for (std::int32_t x = first; x < width - first; ++x)
            put(left + x, top + y, value, square);
    }
}

void fillPolygon(std::span<const ShapeVertex> vertices, std::uint8_t value, const ByteSquare& square) noexcept {
    for (std::int32_t y = 0; y < square.Side; ++y) {
        for (std::int32_t x = 0; x < square.Side; ++x) {
            if (inside(vertices, x, y)) put(x, y, value, square);
        }
    }
    for (std::size_t i = 0, j = vertices.size() - 1; i < vertices.size(); j = i++) {
        drawLine(vertices[j], vertices[i], value, square);
    }
}
