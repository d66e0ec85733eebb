// The commands that lead to another mode.
#pragma once

#include "editor/mode_switch.h"

void mnuSelect_Click(const ModeContext& context);
void mnuItemTool_Click(const ModeContext& context);

// mnuDraw_Click and the eight other tool commands. tool: 1..9. A wizard whose prop would not fit is refused in a box.
void drawTool_Click(int tool, const ModeContext& context);

// button: kToggleFixtures or kToggleProps. A click on the pressed button keeps it pressed.
void chkCmdFixtureOrProp_MouseUp(int button, bool leftButton, const ModeContext& context);

void chkSimplePropMode_Click(bool simple, const ModeContext& context);
