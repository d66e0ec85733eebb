// The bare tree at the left of the example: its limbs are painted, and its lights are wound along them.
#pragma once

#include "scene.h"

#include <vector>

struct TreeLimb {
    ScenePoint from;
    ScenePoint to;
    double thickness = 0;  // pixels
    int order = 0;         // 0 trunk, 1 bough, 2 branch, 3 twig
    int bough = 0;         // which of the main boughs it belongs to, from 1; 0 = the trunk
};

// From the trunk outward; the same at every call.
std::vector<TreeLimb> bigTreeLimbs();
