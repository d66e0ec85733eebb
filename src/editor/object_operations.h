// What the commands do to the document and to the selected object.
#pragma once

#include "editor/edit_context.h"

// The document differs from its file from here on, which panel 1 tells.
void markChanged(const ModeContext& context);

// Moves the selection so that the upper left corner of its box lies at (ZephHandleSize, ZephHandleSize), locked
// fixtures of a prop too: where an object is put that comes from elsewhere.
void HomeThisObject(const ModeContext& context);
