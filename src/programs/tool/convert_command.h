// zeph-tool convert: a display of any version, written as one of the present version.
#pragma once

#include "programs/tool/options.h"

int runConvert(const ToolOptions& options);
