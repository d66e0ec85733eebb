// What one frame asks of the OpenGL canvas: colours for the slots of the plan, bulbs that came as lists, and the order
// in which both are painted. All storage is reserved at entry into simulation.
#pragma once

#include <cstdint>
#include <vector>

// A listed bulb.
struct GLInstance {
    std::int16_t X = 0;  // pixels, the centre
    std::int16_t Y = 0;
    std::uint32_t Color = 0;  // packed colour, alpha in the highest byte
};

// One drawing call.
struct GLBatch {
    std::int32_t Shape = -1;  // of listed bulbs: into GLPlan::Shapes; -1 = ranges of the plan's triangles
    std::int32_t First = 0;   // into Instances, or into RangeCounts
    std::int32_t Count = 0;
};

struct GLWork {
    std::vector<std::uint32_t> SlotColors;  // as of GLInstance; 0 = nothing is drawn in this slot
    std::int32_t FirstSlot = 0;             // of those that this work uses
    std::int32_t EndSlot = 0;               // one past the last
    std::vector<std::int32_t> RangeCounts;  // indices in a range
    std::vector<const void*> RangeOffsets;  // bytes into the index buffer, in the form that OpenGL takes them
    std::vector<GLInstance> Instances;
    std::vector<GLBatch> Batches;
};
