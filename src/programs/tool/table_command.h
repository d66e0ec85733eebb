// zeph-tool table: the display as a simulation compiles it.
#pragma once

#include "programs/tool/options.h"

int runTable(const ToolOptions& options);
