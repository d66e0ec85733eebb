// What the object list beside the canvas shows: the fixtures by name or, where props are selected, the props.
#pragma once

#include "editor/mode_switch.h"

#include <string>
#include <vector>

// One row of the list.
struct ZephListEntry {
    std::string SortKey;
    std::int32_t Object = 0;  // fixture
    std::string Text;         // one line, or two joined by a line feed
    bool Locked = false;      // the fixture's lock, or its prop's where props are selected

    bool operator==(const ZephListEntry&) const = default;
};

// The rows in the order of their keys; rows with equal keys stay in the order of their fixtures. Empty where no
// document is open.
std::vector<ZephListEntry> ZephListIndex(const ZephSimulation& simulation, const ZephEditorState& editor);

// False where the list does not take clicks: in a running simulation, while a stroke is under way, without a document.
bool listTakesClicks(const ZephSimulation& simulation, const ZephEditorState& editor) noexcept;

// Selects a fixture of the list, locked or not. From Drawing it goes to Select Fixture first. Nothing where the list
// takes no clicks.
void flgObjectSelect_Click(std::int32_t object, const ModeContext& context);
