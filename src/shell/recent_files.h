// The list of the most recent editor files, newest first, without gaps: kept in the settings, shown in the File menu.
#pragma once

#include "model/settings.h"
#include "util/paths.h"

#include <string>
#include <string_view>
#include <vector>

// Makes the full path the newest. It is told from the others without regard to case; the oldest falls off.
void ZephUpdateRecentFilesList(std::string_view path, ZephSettings& settings);

// Folder and name in at most maxLength characters: the beginning of the folder, "...\" and the name, or the beginning
// of a long name. name "": folder holds both.
std::string ZephDisplayFileName(int maxLength, std::string_view folder, std::string_view name);

// The captions of mnuRecentFiles(0) and on, such as "&1 <base>/Editor/show.zee"; none for an empty list, whose menu
// mnuFileRecent stays hidden. An ampersand in a path is doubled, or the menu would underline what follows it.
std::vector<std::string> ZephRecentFileCaptions(const ZephSettings& settings, const ZephPathService& paths);

// What the setting "On Startup" asks for when no file was opened from the command line.
enum class StartupAction { Nothing, ShowOpenDialog, OpenNewest };

// The newest is opened only where there are at least two: with a single one the dialog appears.
StartupAction ZephStartupAction(const ZephSettings& settings);
