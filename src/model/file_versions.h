// The version gate that editor, fixture and prop files pass. A version is compared as it is spelled.
#pragma once

#include <algorithm>
#include <array>
#include <string_view>

struct FileVersionRow {
    std::string_view version;
    bool version3;  // read as version 3; the older ones as version 2, and an editor file of theirs counts as upgraded
};
inline constexpr std::array kFileVersions{FileVersionRow{"1.5.2", false}, FileVersionRow{"2.0.0", false},
                                          FileVersionRow{"2.0.1", false}, FileVersionRow{"2.1.0", false},
                                          FileVersionRow{"3.0.0", true}};

inline constexpr std::string_view kIncompatibleVersionTitle = "-Not a valid file";
inline constexpr std::string_view kIncompatibleVersion =
    "Error:  The File Version is incompatible for this application.\r\nPlease contact support for an upgrade.";

// nullptr for a version that is not read.
inline const FileVersionRow* findFileVersion(std::string_view version) noexcept {
    const auto row = std::ranges::find(kFileVersions, version, &FileVersionRow::version);
    return row == kFileVersions.end() ? nullptr : &*row;
}
