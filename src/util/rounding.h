// The only place where real numbers become whole ones, and wide ones narrow. Each conversion names its rule; a result
// that does not fit 32 bits saturates.
#pragma once

#include <cmath>
#include <cstdint>
#include <limits>

namespace rounding_detail {
inline std::int32_t saturate(double whole) noexcept {
    constexpr double low = std::numeric_limits<std::int32_t>::min();
    constexpr double high = std::numeric_limits<std::int32_t>::max();
    if (!(whole > low)) return whole == whole ? std::numeric_limits<std::int32_t>::min() : 0;
    return whole >= high ? std::numeric_limits<std::int32_t>::max() : static_cast<std::int32_t>(whole);
}
}  // namespace rounding_detail

// To the nearest whole number, a tie to the even neighbour: 0.5 -> 0, 1.5 -> 2, -0.5 -> 0.
inline std::int32_t roundHalfEven(double value) noexcept {
    return rounding_detail::saturate(std::nearbyint(value));
}

// The largest whole number not above the value: -0.5 -> -1.
inline std::int32_t floorToInt(double value) noexcept {
    return rounding_detail::saturate(std::floor(value));
}

// The fraction is cut off: -0.5 -> 0.
inline std::int32_t truncateToInt(double value) noexcept {
    return rounding_detail::saturate(std::trunc(value));
}

// A sum or product of 32-bit numbers back into 32 bits.
constexpr std::int32_t saturate(std::int64_t value) noexcept {
    constexpr std::int64_t low = std::numeric_limits<std::int32_t>::min();
    constexpr std::int64_t high = std::numeric_limits<std::int32_t>::max();
    return static_cast<std::int32_t>(value < low ? low : value > high ? high : value);
}

// Into 0..255.
constexpr std::int32_t clampByte(std::int32_t value) noexcept {
    return value < 0 ? 0 : value > 255 ? 255 : value;
}

// dividend / divisor to the nearest whole number, a tie to the even neighbour, in exact arithmetic.
// The divisor is above 0, the dividend not below it.
constexpr std::int32_t divideHalfEven(std::int32_t dividend, std::int32_t divisor) noexcept {
    const std::int32_t quotient = dividend / divisor;
    const std::int32_t twice = 2 * (dividend % divisor);
    return quotient + (twice + (quotient & 1) > divisor ? 1 : 0);  // the odd neighbour tips a tie; no branch to guess
}

namespace rounding_detail {
// floor(value x numerator / denominator) and what is left over, 0..denominator - 1. The denominator is above 0.
struct Quotient {
    std::int64_t whole;
    std::int64_t rest;
};
constexpr Quotient scaled(std::int32_t value, std::int32_t numerator, std::int32_t denominator) noexcept {
    const std::int64_t product = std::int64_t{value} * numerator;
    std::int64_t whole = product / denominator;
    if (product % denominator < 0) --whole;
    return {whole, product - whole * denominator};
}
}  // namespace rounding_detail

// value x numerator / denominator to the nearest whole number, in exact arithmetic: a tie to the even neighbour, or
// upwards on the number line. The denominator is above 0.
constexpr std::int32_t scaleHalfEven(std::int32_t value, std::int32_t numerator, std::int32_t denominator) noexcept {
    const auto [whole, rest] = rounding_detail::scaled(value, numerator, denominator);
    return saturate(whole + (2 * rest + (whole & 1) > denominator ? 1 : 0));
}
constexpr std::int32_t scaleHalfUp(std::int32_t value, std::int32_t numerator, std::int32_t denominator) noexcept {
    const auto [whole, rest] = rounding_detail::scaled(value, numerator, denominator);
    return saturate(whole + (2 * rest >= denominator ? 1 : 0));
}

// Intensity 0..100 to level 0..255, which is intensity x 2.55 in exact arithmetic: once cut off, once rounded.
constexpr std::int32_t levelCut(std::int32_t intensity) noexcept {
    return intensity * 255 / 100;
}
constexpr std::int32_t levelRounded(std::int32_t intensity) noexcept {
    return divideHalfEven(intensity * 255, 100);
}
static_assert(levelCut(100) == 255 && levelCut(1) == 2 && levelRounded(50) == 128 && levelRounded(10) == 26);
