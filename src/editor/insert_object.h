// Brings a fixture or a prop of another display in, from its file. Home is where it lands.
#pragma once

#include "editor/edit_context.h"

// Each asks for the file, and whether channels that come along are to be kept. A file that fails was told, and leaves
// no undo step behind.
void mnuInsertFixture_Click(const EditContext& context);
void mnuInsertProp_Click(const EditContext& context);
