// Every folder of the program through one function.
#pragma once

#include "model/settings.h"
#include "util/paths.h"

// kind: 1 editor files, 2 fixture files, 3 prop files, 4 curves, 6 the second installation folder, 7 System. Each
// ends with the separator; kind 5 and any other give "".
std::string ZephReturnDataDirectory(int kind, const ZephPathService& paths, const ZephSettings& settings);
