// zeph-tool demo-show: a capture that shows off a display.
#pragma once

#include "programs/tool/options.h"

int runDemoShow(const ToolOptions& options);
