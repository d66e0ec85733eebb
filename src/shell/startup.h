// What happens between the start of the process and the first event, and the way in of an editor file.
#pragma once

#include "shell/program.h"

#include <functional>
#include <string_view>

// Each step's text, as the start-up screen shows it.
using StartupMessage = std::function<void(std::string_view text)>;

// Brings the program's state up, in the fixed order. A missing folder, curve or adapter is repaired or reported; the
// start goes on.
void ZephStartUp(const StartupMessage& status, Program& program);

// The window's title: the program's name, its version and, behind a "-", the name of the open file.
std::string ZephWindowTitle(std::string_view fileName);
