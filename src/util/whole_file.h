// Replaces a file whole or not at all.
#pragma once

#include <string>
#include <string_view>

// Writes beside the file, flushes, and renames; a reader sees the old bytes or the new ones. False when the disk or
// the file's rights refuse, and the old file is then untouched. path is UTF-8.
[[nodiscard]] bool replaceWholeFile(const std::string& path, std::string_view bytes);
