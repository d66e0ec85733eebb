// Taking the last change back, and making it again, as the user commands it.
#pragma once

#include "editor/edit_context.h"

// Nothing where there is nothing to take back or to make again.
void mnuUndo_Click(const EditContext& context);
void mnuRedo_Click(const EditContext& context);
