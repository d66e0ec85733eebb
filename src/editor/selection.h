// What is selected, and the box around it. An object is named by a fixture; while props are selected, a fixture of a
// prop stands for the whole prop. Coordinates are twips.
#pragma once

#include "editor/mode_switch.h"
#include "util/units.h"

#include <vector>

inline constexpr std::int32_t ZephHandleSize = 6 * TwipsPerPixelX;  // corner boxes, and the margin of HomeThisObject

struct ZephBox {
    std::int32_t Left = 0;
    std::int32_t Top = 0;
    std::int32_t Right = 0;
    std::int32_t Bottom = 0;

    bool operator==(const ZephBox&) const = default;
};

// The fixtures that the object stands for: those of its prop in the prop's order where props are selected, else itself.
std::vector<std::int32_t> fixturesOfObject(std::int32_t object, const ZephSimulation& simulation,
                                           const ZephEditorState& editor);

// The box around the points of the object's fixtures and around bulbs that have a size of their own. Locked fixtures
// count only while locks are ignored; where nothing counts, box stays as it was. wholeFixtureOnly: never the whole
// prop.
void ZephFindObjectMinMax(std::int32_t object, bool wholeFixtureOnly, const ZephSimulation& simulation,
                          const ZephEditorState& editor, ZephBox& box);

// Selects the object: ZephSelection with its box, and its row in the list. Where whole props count as one object, a
// fixture of a prop selects the prop's first.
void ZephFoundObject(std::int32_t object, const ModeContext& context);
