// The four files opened or saved last, newest first, as the File menu shows them.
#pragma once

#include "model/settings.h"
#include "util/paths.h"

#include <QStringList>

#include <string>
#include <string_view>

inline constexpr int kMostRecentFiles = 4;
inline constexpr int kRecentFileLength = 35;  // characters of a menu entry

// Puts a path in front of the list. The case of letters does not matter; the fifth file drops out.
void ZephUpdateRecentFilesList(std::string_view path, ZephSettings& settings);

// folder and name cut to maxLength characters, the name kept as long as it fits. An empty name: both are taken from
// the folder text.
std::string ZephDisplayFileName(int maxLength, std::string_view folder, std::string_view name);

// UpdateRecentFileMenu: the captions of mnuRecentFiles, newest first.
QStringList recentFileCaptions(const ZephSettings& settings, const ZephPathService& paths);
