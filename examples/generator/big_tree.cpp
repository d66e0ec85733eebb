#include "big_tree.h"

#include "util/random_source.h"

#include <cmath>

namespace {

void grow(ScenePoint from, double angle, double length, double thickness, int order, int bough, RandomSource& random,
          std::vector<TreeLimb>& limbs) {
    const ScenePoint to{from.x + std::cos(angle) * length, from.y - std::sin(angle) * length};
    limbs.push_back({from, to, thickness, order, bough});
    if (order == 3) return;
    const int children = order == 0 ? 5 : 3;
    for (int child = 0; child < children; ++child) {
        const double spread = order == 0 ? 2.05 : 1.25;
        const double turn = spread * (static_cast<double>(child) / (children - 1) - 0.5) + 0.16 * (random.next() - 0.5);
        // Boughs leave the trunk at its end, branches along the outer part of their bough.
        const double share = order == 0 ? 1.0 : 0.62 + 0.38 * child / (children - 1);
        const ScenePoint start{from.x + (to.x - from.x) * share, from.y + (to.y - from.y) * share};
        grow(start, angle + turn, length * (order == 0 ? 0.76 : 0.62) * (0.9 + 0.2 * random.next()), thickness * 0.52,
             order + 1, order == 0 ? child + 1 : bough, random, limbs);
    }
}

}  // namespace

std::vector<TreeLimb> bigTreeLimbs() {
    SeededRandom random(12);
    std::vector<TreeLimb> limbs;
    grow(scene::kBigTree, 1.5708, 128, 20, 0, 0, random, limbs);
    return limbs;
}
