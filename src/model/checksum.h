// The editor file's checksum: MD5 over the file's own text without the checksum's attribute, followed by a seed.
// It tells a file that was changed outside the program; it protects nothing.
#pragma once

#include <QCryptographicHash>

#include <condition_variable>
#include <cstdint>
#include <future>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

// MD5 (RFC 1321). Values are upper-case hexadecimal, 32 characters.
class MD5Hash {
public:
    void NewHash() { hash_.reset(); }
    void HashBlock(std::string_view bytes);
    std::string HashValue() const;

    // The value of the bytes alone, whatever was hashed before.
    std::string HashBytes(std::string_view bytes);
    // The value of a file's bytes. Throws Failure "File doesn't exist" when it cannot be opened.
    std::string HashFile(const std::string& path);

private:
    QCryptographicHash hash_{QCryptographicHash::Md5};
};

// Only its decimal text counts. Every build must use the same one, or it would distrust the others' files.
inline constexpr std::int32_t kChecksumSeed = 20481973;

struct TextRange {
    std::size_t begin = 0;  // byte offset, from 0
    std::size_t end = 0;    // one past the last
};

// The attribute Chksum of a start tag, with the white space before it: what is left out of the hashed text. tagName is
// the offset of the tag's name in the text. Any quotes, any place among the attributes; nothing when it is not there.
std::optional<TextRange> findChecksumAttribute(std::string_view text, std::size_t tagName);

// The checksum of a document's UTF-8 text with a part left out. What is hashed is the text as UTF-16 code units, low
// byte first, then the decimal seed; or one blank instead of the seed for a document whose mismatch is to stay marked.
std::string editorChecksum(std::string_view text, TextRange leftOut, bool keepMismatch);

// The same checksum of a text that is still being made, computed on a second thread piece by piece.
class RunningChecksum {
public:
    RunningChecksum();
    ~RunningChecksum();

    // The piece must stay where it is until value() has returned. It may end inside a character.
    void add(std::string_view piece);
    // Once, behind the last piece. Throws what the hash threw.
    std::string value(bool keepMismatch);

private:
    std::string compute();
    void close(bool keepMismatch);

    std::mutex mutex_;
    std::condition_variable changed_;
    std::vector<std::string_view> waiting_;
    bool closed_ = false;
    bool keepMismatch_ = false;
    std::future<std::string> computed_;
};
