// Filled shapes without smoothing, on a square of bytes. Whole-number arithmetic alone, so a mask is the same on every
// machine, which a drawing library's own edge rule would not promise.
#pragma once

#include "engine/bulb_shapes.h"

#include <cstdint>
#include <span>

// A square of side x side bytes, row by row.
struct ByteSquare {
    std::uint8_t* Bytes = nullptr;
    std::int32_t Side = 0;  // pixels
};

// The ellipse that fills the box [left, right) x [top, bottom): a pixel belongs to it when its centre does. Symmetric
// both ways. The box lies within the square; an empty box draws nothing.
void fillEllipse(std::int32_t left, std::int32_t top, std::int32_t right, std::int32_t bottom, std::uint8_t value,
                 const ByteSquare& square) noexcept;

// The polygon together with its outline, one pixel wide, vertices standing on pixels; what lies outside the square is
// cut off. The outline keeps the thin points of stars in one piece.
void fillPolygon(std::span<const ShapeVertex> vertices, std::uint8_t value, const ByteSquare& square) noexcept;
