// Small text helpers. Text of the core is UTF-8 in std::string; the stream's is Latin-1 bytes.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

// Without the white space at both ends (blank, tab, carriage return, line feed).
std::string_view trimmed(std::string_view text) noexcept;

// A trimmed decimal number of 32 bits with an optional sign; nothing for any other text.
std::optional<std::int32_t> parseLong(std::string_view text) noexcept;

// "True" or "False" in any case, trimmed; nothing for any other text.
std::optional<bool> parseFlag(std::string_view text) noexcept;

// Equal but for the case of A..Z.
bool equalIgnoringCase(std::string_view left, std::string_view right) noexcept;

// Lower case of every character, by Unicode's rules.
std::string lowerCase(std::string_view utf8);

std::string utf8FromLatin1(std::string_view bytes);

// Splits after the last separator, '/' or '\'. The folder keeps its separator.
std::string ZephNameFromFullPath(std::string_view path);
std::string ZephPathFromFullPath(std::string_view path);
