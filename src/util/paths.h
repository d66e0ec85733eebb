// Where the program keeps its files: the base folder of the user's data, and the conversion of paths to and from the
// form in which settings and documents store them.
#pragma once

#include <string>
#include <string_view>

// Kinds of folder that the path service knows.
inline constexpr int kPathInstallation = 1;  // shared, read-only files of the installation
inline constexpr int kPathPrivate = 2;       // the user's own files of the program family
inline constexpr int kPathBase = 5;          // the data base folder

class ZephPathService {
public:
    // base: the data base folder, any spelling. Nothing is created.
    explicit ZephPathService(std::string_view base);

    // The base folder of this user: $ZEPH_DATA if set, else "Zeph" under the platform's application data folder.
    static std::string userBase();

    // The folder of a kind, ending with the separator; "" for an unknown kind.
    std::string GetPath(int kind) const;

    // The stored form of a full path: below the folder of the kind it is a marker and the rest, otherwise the path
    // itself. ExpandPath turns it back.
    std::string CollapsePath(std::string_view fullPath, int kind) const;
    std::string ExpandPath(std::string_view storedPath, int kind) const;

private:
    std::string base_;
};

// Creates the folders of the program that do not exist yet. Always true: a folder that cannot be made shows when it
// is used.
bool ZephCheckDirectoriesAtStartup(const ZephPathService& paths);
