// The dialogs that ask for a file: one row each, with the words that they show. The window shows them; a test answers
// from a script.
#pragma once

#include <string>
#include <string_view>

struct FileDialog {
    std::string_view title;
    std::string_view filter;     // what is shown, "|" and the pattern
    std::string_view extension;  // of the pattern; a name to be saved gets it where it has it not
    int folder;                  // kind of ZephReturnDataDirectory that it starts in
};

inline constexpr std::string_view kEditorFilter = "Zeph Editor Environment Files (ZEE)|*.zee";
inline constexpr std::string_view kFixtureFilter = "Zeph Fixtures (ZFF)|*.zff";
inline constexpr std::string_view kPropFilter = "Zeph Props (ZPF)|*.zpf";

inline constexpr FileDialog kLoadEditorFile{"Load File", kEditorFilter, ".zee", 1};
inline constexpr FileDialog kSaveEditorFile{"Save File", kEditorFilter, ".zee", 1};
inline constexpr FileDialog kLoadFixtureFile{"Load Fixture File", kFixtureFilter, ".zff", 2};
inline constexpr FileDialog kSaveFixtureFile{"Save Fixture File", kFixtureFilter, ".zff", 2};
inline constexpr FileDialog kLoadPropFile{"Load Prop File", kPropFilter, ".zpf", 3};
inline constexpr FileDialog kSavePropFile{"Save Prop File", kPropFilter, ".zpf", 3};

class FileDialogs {
public:
    virtual ~FileDialogs() = default;
    // A file to read. False when cancelled.
    virtual bool chooseInput(const FileDialog& dialog, std::string& fullPath) = 0;
    // A file to write, with its extension; one that exists was agreed to. False when cancelled.
    virtual bool chooseOutput(const FileDialog& dialog, std::string& fullPath) = 0;
};
