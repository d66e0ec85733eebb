// zeph-tool render: frames of a simulation as a picture, a film or a folder of pictures.
#pragma once

#include "programs/tool/options.h"

int runRender(const ToolOptions& options);
