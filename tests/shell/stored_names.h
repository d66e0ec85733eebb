// What the store of a first run holds once it is written: every name, its value, and what a number may be.
#pragma once

#include <array>
#include <cstdint>
#include <limits>
#include <string>

namespace stored {

inline constexpr std::int32_t kNoLimit = std::numeric_limits<std::int32_t>::max();

struct Number {
    const char* name;
    std::int32_t usual;
    std::int32_t least;
    std::int32_t most;
};
struct Flag {
    const char* name;
    const char* usual;
};

// clang-format off
inline constexpr auto kNumbers = std::to_array<Number>({
    {"Left", 0, 0, kNoLimit}, {"Top", 0, 0, kNoLimit}, {"Width", 20970, 2100, kNoLimit},
    {"Height", 16095, 2950, kNoLimit}, {"State", 0, 0, 2}, {"On Startup", 0, 0, 2}, {"Bulb Size", 2, 1, 16},
    {"Bulb Spacing", 2, 0, 64}, {"Bulb Shape", 1, 1, 11}, {"Kesh Bulb Shape", 11, 11, 11}, {"Flood Size", 32, 1, 64},
    {"Flood Opacity", 50, 5, 100}, {"ZOrder", 1, 0, 16}, {"Auto Save", 0, 0, kNoLimit}, {"Show Grid", 0, 0, 4},
    {"Grid Density", 1, 1, 20}, {"Grid Color", 0, 0, 16777215}, {"Fixture Text Color", 0, 0, kNoLimit},
    {"Tool Handle Color", 255, 0, kNoLimit}, {"Vertex Handle Color", 65280, 0, kNoLimit},
    {"Sample Background Color", 0, 0, kNoLimit}, {"Sample RGB Color", 0, 0, kNoLimit},
    {"Default Channel Type", 1, 1, 2}, {"Fixture Text Location", 1, 0, 7}, {"Last Opts Tab", 0, 0, 5},
    {"Simulation Port", 30303, 0, 65535}, {"Strobe Fire Time", 50, 0, 100}, {"Draw Pixel Qty", 2, 2, 500},
    {"ToolTips PixelFlash", 5, 1, 25}, {"ToolTips NumAsgnChannels", 16, 0, 16},
    {"ToolTips NumAsgnFixtures", 64, 0, 64}, {"Arch Wizard Type", 0, 0, 1}, {"Arch Wizard Size", 50, 10, 100},
    {"Arch Wizard First Location", 0, 0, 1}, {"Arch Wizard Segments", 7, 1, 64},
    {"Arch Wizard Channel Type", 0, 0, 2}, {"Arch Wizard Pixels Per Segment", 2, 2, 50},
    {"Arch Wizard Fill Density", 5, 1, 10}, {"Tree Wizard Size", 50, 25, 150}, {"Tree Wizard Top Size", 50, 0, 150},
    {"Tree Wizard XRot", 75, 0, 180}, {"Tree Wizard YRot", 0, -89, 89}, {"Tree Wizard Height", 100, 25, 150},
    {"Tree Wizard Type", 1, 0, 1}, {"Tree Wizard Bundle Type", 0, 0, 12}, {"Tree Wizard First Location", 0, 0, 1},
    {"Tree Wizard Number of Bundles", 8, 4, 64}, {"Tree Wizard Consecutive Bundles", 1, 1, 32},
    {"Tree Wizard Channel Type", 0, 0, 1}, {"Tree Wizard Pixels Per Segment", 2, 2, 170},
    {"Matrix Wizard Bulb Size", 2, 1, 16}, {"Matrix Wizard Channel Type", 1, 1, 2},
    {"Matrix Wizard Horiz Spacing", 5, 1, 50}, {"Matrix Wizard Vert Spacing", 5, 1, 50},
    {"Matrix Wizard Pixel Height", 10, 1, 170}, {"Matrix Wizard Pixel Width", 10, 1, 170},
    {"Matrix Wizard Orientation", 1, 0, 1}, {"Matrix Wizard Origin", 0, 0, 3},
});

inline constexpr auto kFlags = std::to_array<Flag>({
    {"Confirm Deletes", "True"}, {"LED Default", "False"}, {"Properties On New Fixture", "True"},
    {"Properties On Editor Select", "False"}, {"Properties On List Select", "False"},
    {"Properties On Add Points", "True"}, {"Properties On Object Undo", "True"}, {"Properties On Wizard Use", "True"},
    {"Assume New Object", "False"}, {"Always Show Prop Names", "False"}, {"Simple Prop Display", "True"},
    {"Reference File Warning", "False"}, {"Bulb Size Warning", "False"}, {"Kesh Bulb Count Warning", "False"},
    {"Edit In Color", "True"}, {"Show Pixel Order", "True"}, {"Background Warning", "False"},
    {"End Stops Simulation", "True"}, {"No Corrupt File Warning", "False"}, {"Disable Fixture Text", "False"},
    {"Check File Extension", "True"}, {"Force Simulation Forward", "False"}, {"Advanced Render Engine", "True"},
    {"Use TCP", "False"}, {"Channel Default Name", "False"}, {"Channel Default Order Num", "False"},
    {"Channel Default RGB Color", "False"}, {"No Fixture Names During Selection", "False"},
    {"Arch Wizard Option Fill Fan", "False"}, {"Arch Wizard Center to Edge", "False"},
    {"Arch Wizard Correct Arch", "True"}, {"Tree Wizard Option CC", "False"},
    {"Tree Wizard Option Base Lights", "True"}, {"Matrix Wizard Snake Pattern", "False"},
    {"Matrix Wizard Show Flow", "False"}, {"ToolTips Show", "True"}, {"ToolTips Always Show Fixture", "True"},
    {"ToolTips Asgn Prop", "True"}, {"ToolTips Kesh Hardware", "True"}, {"ToolTips Kesh Modes", "True"},
    {"ToolTips Kesh Resolution", "True"}, {"ToolTips Comment", "True"}, {"ToolTips Level", "True"},
    {"ToolTips Lock", "True"}, {"ToolTips Name", "True"}, {"ToolTips Opacity", "True"}, {"ToolTips Points", "True"},
    {"ToolTips PropComment", "True"}, {"ToolTips PropLock", "True"}, {"ToolTips PropName", "True"},
    {"ToolTips Size", "True"}, {"ToolTips Type", "True"},
});
// clang-format on

}  // namespace stored
