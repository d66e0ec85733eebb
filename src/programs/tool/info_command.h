// zeph-tool info: what is in a display.
#pragma once

#include "programs/tool/options.h"

int runInfo(const ToolOptions& options);
