// What the OpenGL output works out once, at entry into simulation: the triangles of every bulb in the order in which
// frames paint them, and where the colour of each is looked up. No OpenGL in here; the canvas puts it on the GPU.
#pragma once

#include "engine/fixture_state.h"
#include "engine/gl_shapes.h"
#include "engine/paint_order.h"
#include "engine/render_table.h"

#include <cstdint>
#include <vector>

// A corner of a bulb. Its colour is the one that stands in its slot in this frame.
struct GLVertex {
    std::int16_t X = 0;  // pixels
    std::int16_t Y = 0;
    std::uint32_t Slot = 0;
};

struct GLCorner {
    std::int16_t X = 0;  // pixels, from the centre of the bulb
    std::int16_t Y = 0;
};

// The triangles of one shape at one size, for bulbs that come as lists.
struct GLShapeRange {
    std::int32_t FirstIndex = 0;  // into CornerIndices
    std::int32_t IndexCount = 0;
};

// A plain channel or an RGB group. Units are numbered from 1 in the order of painting.
struct GLPlanUnit {
    std::int32_t Fixture = 0;
    std::int32_t Shape = -1;      // into Shapes; -1 = nothing is drawn: no such size or shape, or special type
    std::int32_t FirstIndex = 0;  // into Indices
    std::int32_t IndexCount = 0;  // 0 = its bulbs only come as lists
    std::int32_t FirstSlot = 0;   // bulb b, from 0, has the slot FirstSlot + b % SlotCount
    std::int32_t SlotCount = 0;   // one; one a colour of a Multi Color channel; one a bulb of a flashing channel
    std::int32_t FirstBulb = 0;   // into BulbPool, as in ZephBulbLocations
    std::int32_t BulbCount = 0;
};

struct GLPlan {
    std::vector<GLPlanUnit> Units;  // [0] not used
    UnitNumbers NumberOf;           // into Units
    std::vector<GLVertex> Vertices;
    std::vector<std::uint32_t> Indices;  // three a triangle, into Vertices, by unit
    std::vector<std::uint32_t>
        SlotColors;                 // packed colour of each slot; 0 for groups, whose colour comes with the draw
    std::vector<GLCorner> Corners;  // of Shapes
    std::vector<std::uint16_t> CornerIndices;  // three a triangle, into Corners
    std::vector<GLShapeRange> Shapes;
    std::int32_t ListedBulbs = 0;  // bulbs of fixtures that are drawn by lists: ribbons and pixels
};

// Whether a bulb is drawn at all: no place holder, and near enough for the coordinates of a vertex.
bool drawnBulb(const ZephBulbLocation& bulb) noexcept;

// Throws Failure where the display has more bulbs than indices can count.
GLPlan makeGLPlan(const ZephSimulation& document, const ZephRenderTables& tables, const ZephFixtureStates& states,
                  const ZephGLShapes& shapes);
