// Where the parts of the example's house and garden stand. The painter and the display read the same figures, so that
// the lights sit on the eaves of the picture. All lengths are canvas pixels, y down.
#pragma once

#include <array>

struct ScenePoint {
    double x = 0;
    double y = 0;
};

struct SceneBox {
    double left = 0;
    double top = 0;
    double right = 0;
    double bottom = 0;

    constexpr double width() const { return right - left; }
    constexpr double height() const { return bottom - top; }
    constexpr ScenePoint centre() const { return {(left + right) / 2, (top + bottom) / 2}; }
};

// A front gable: the ends of its two rafters and the wall below.
struct SceneGable {
    ScenePoint leftEave;
    ScenePoint apex;
    ScenePoint rightEave;
    SceneBox wall;  // up to the eaves
};

struct SceneFir {
    ScenePoint foot;
    double height = 0;
    double half = 0;  // half its width at the lowest branches
};

struct SceneFence {
    ScenePoint from;  // top of the first and the last post
    ScenePoint to;
};

struct SceneBush {
    ScenePoint middle;
    double halfWidth = 0;
    double halfHeight = 0;
};

namespace scene {

inline constexpr int kWidth = 1280;
inline constexpr int kHeight = 800;

inline constexpr double kHouseBase = 616;  // where the walls meet the snow

inline constexpr SceneGable kLeftWing{{276, 428}, {400, 250}, {524, 428}, {300, 424, 500, kHouseBase}};
inline constexpr SceneGable kGarage{{780, 470}, {900, 340}, {1020, 470}, {800, 466, 1000, kHouseBase}};
inline constexpr SceneBox kMainWall{500, 430, 800, kHouseBase};
inline constexpr ScenePoint kRidgeLeft{424, 286};
inline constexpr ScenePoint kRidgeRight{784, 286};
inline constexpr ScenePoint kEaveLeft{480, 432};
inline constexpr ScenePoint kEaveRight{826, 432};
inline constexpr SceneBox kChimney{728, 222, 768, 312};

inline constexpr double kDormerHalf = 31;  // half its width
inline constexpr double kDormerEave = 350;
inline constexpr double kDormerBase = 398;
inline constexpr double kDormerTop = 314;
inline constexpr std::array<double, 2> kDormers{566, 672};  // centres

inline constexpr SceneBox kPorchRoof{516, 462, 784, 502};
inline constexpr std::array<double, 4> kPorchPosts{530, 606, 694, 770};
inline constexpr SceneBox kDoor{628, 526, 672, kHouseBase - 6};
inline constexpr ScenePoint kWreath{650, 552};

inline constexpr SceneBox kGableWindow{372, 346, 428, 430};
inline constexpr SceneBox kBayWindow{336, 492, 464, 580};
inline constexpr SceneBox kPorchWindowLeft{548, 530, 590, 588};
inline constexpr SceneBox kPorchWindowRight{710, 530, 752, 588};
inline constexpr SceneBox kGarageDoor{824, 496, 976, kHouseBase - 2};
inline constexpr ScenePoint kGarageStar{900, 412};

// The window of dormer 0 or 1.
constexpr SceneBox dormerWindow(std::size_t dormer0) {
    const double x = kDormers.at(dormer0);
    return {x - 15, kDormerEave + 2, x + 15, kDormerBase - 8};
}

// The garden path: its middle and half width at t, 0 at the porch and 1 at the lower edge of the picture.
constexpr ScenePoint pathMiddle(double t) {
    return {650 - 34 * t * t, kHouseBase + 2 + (kHeight - kHouseBase) * t};
}
constexpr double pathHalfWidth(double t) {
    return 24 + 58 * t;
}

inline constexpr ScenePoint kBigTree{164, 668};  // foot of the bare tree
inline constexpr ScenePoint kMegaTree{1138, 716};
inline constexpr double kMegaTreeHeight = 372;
inline constexpr double kMegaTreeHalf = 104;

inline constexpr std::array<SceneFir, 4> kFirs{{
    {{62, 642}, 208, 56},
    {{246, 630}, 150, 42},
    {{1052, 634}, 142, 40},
    {{1220, 650}, 228, 56},
}};

inline constexpr double kFencePitch = 22;
inline constexpr std::array<SceneFence, 2> kFences{{{{4, 628}, {290, 606}}, {{1010, 606}, {1276, 632}}}};

inline constexpr std::array<SceneBush, 4> kBushes{{
    {{342, 604}, 44, 24},
    {{452, 606}, 46, 22},
    {{556, 608}, 34, 18},
    {{744, 608}, 34, 18},
}};

inline constexpr ScenePoint kSnowman{236, 716};                              // its foot
inline constexpr std::array<ScenePoint, 2> kDeer{{{330, 700}, {432, 716}}};  // feet, looking right

inline constexpr int kArches = 5;
inline constexpr double kArchBase = 776;
inline constexpr double kArchHalf = 40;
inline constexpr double kArchHeight = 62;
constexpr double archMiddle(int arch0) {
    return 62 + 88.0 * arch0;
}

}  // namespace scene
