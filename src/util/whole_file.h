// Replaces a file whole or not at all: the bytes are written beside it, flushed, and renamed. Whoever reads the file,
// at any moment and after any crash, sees the old bytes or the new ones.
#pragma once

#include <memory>
#include <string>
#include <string_view>

class QSaveFile;

class WholeFile {
public:
    // path: UTF-8. A file whose rights forbid writing is refused, though renaming over it would succeed.
    explicit WholeFile(const std::string& path);
    ~WholeFile();  // without commit, the old file stays

    // What fails is remembered, and commit then refuses.
    void append(std::string_view bytes);
    // Replaces bytes that were appended. offset: from 0.
    void overwrite(std::size_t offset, std::string_view bytes);
    // False when the disk or the file's rights refused anything; the old file is then untouched.
    [[nodiscard]] bool commit();

private:
    void write(std::string_view bytes);

    std::unique_ptr<QSaveFile> file_;
    bool good_ = false;
};

// The same for bytes that are there already.
[[nodiscard]] bool replaceWholeFile(const std::string& path, std::string_view bytes);
