#include "link/stream_numbers.h"

#include <algorithm>
#include <limits>

namespace {

constexpr bool isDigit(char letter) noexcept {
    return letter >= '0' && letter <= '9';
}

}  // namespace

std::optional<std::int32_t> readDigits(std::string_view field) noexcept {
    if (field.empty() || field.size() > 9) return std::nullopt;
    std::int32_t number = 0;
    for (const char letter : field) {
        if (!isDigit(letter)) return std::nullopt;
        number = number * 10 + (letter - '0');
    }
    return number;
}

std::optional<std::int32_t> readDurationMs(std::string_view field) noexcept {
    constexpr std::size_t longest = 17;  // keeps every step below within 64 bits
    if (field.empty() || field.size() > longest) return std::nullopt;
    std::int64_t digits = 0;   // the digits without the point
    std::int64_t divisor = 1;  // ten for each place behind the point
    bool pointSeen = false;
    bool digitSeen = false;
    for (const char letter : field) {
        if (letter == '.' && !pointSeen) {
            pointSeen = true;
        } else if (isDigit(letter)) {
            digitSeen = true;
            digits = digits * 10 + (letter - '0');
            if (pointSeen) divisor *= 10;
        } else {
            return std::nullopt;
        }
    }
    if (!digitSeen) return std::nullopt;
    const std::int64_t dividend = digits * 10;  // ten ms make a hundredth
    const std::int64_t quotient = dividend / divisor;
    const std::int64_t twice = 2 * (dividend % divisor);
    const bool up = twice > divisor || (twice == divisor && quotient % 2 == 1);
    return static_cast<std::int32_t>(
        std::min<std::int64_t>(quotient + (up ? 1 : 0), std::numeric_limits<std::int32_t>::max()));
}
