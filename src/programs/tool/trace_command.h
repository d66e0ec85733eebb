// zeph-tool trace: what every frame draws, in order.
#pragma once

#include "programs/tool/options.h"

int runTrace(const ToolOptions& options);
