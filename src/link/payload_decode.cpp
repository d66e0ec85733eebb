#include "link/payload_decode.h"

#include "link/packet_parms.h"
#include "link/stream_numbers.h"
#include "util/rounding.h"

#include <algorithm>
#include <bit>
#include <cstddef>
#include <cstring>

#if defined(__x86_64__) && defined(__GNUC__)
#include <immintrin.h>
#define ZEPH_X86_FORMS 1
#endif

namespace {

constexpr std::size_t kChars = 29;
static_assert(kChars == static_cast<std::size_t>(kLightCommandParm.TotalFixedLength));

// The duration's digits with the point taken out, times 10 (hundredths to ms), divided by ten for each place behind
// the point. pointAt: index of the point among the 8 characters from 0, 8 = none.
inline std::int32_t durationMs(std::int32_t digits, unsigned pointAt) noexcept {
    if (pointAt == 4) return divideHalfEven(digits, 100);  // "0000.000", which nearly every sender writes
    constexpr std::int32_t divisors[7] = {1'000'000, 100'000, 10'000, 1'000, 100, 10, 1};
    return pointAt < 7 ? divideHalfEven(digits, divisors[pointAt]) : digits * 10;
}

// Digits of a fixed width; negative = not all of them are digits.
template <int Width>
std::int32_t number(const char* field) noexcept {
    std::int32_t value = 0;
    bool good = true;
    for (int i = 0; i < Width; ++i) {
        const unsigned digit = static_cast<unsigned char>(field[i]) - unsigned{'0'};
        good = good && digit <= 9;
        value = value * 10 + static_cast<std::int32_t>(digit);
    }
    return good ? value : -1;
}

std::size_t decodePlain(std::string_view text, std::size_t most, ZephChannelCommand* out) noexcept {
    const std::size_t fits = std::min(most, text.size() / kChars);
    for (std::size_t n = 0; n < fits; ++n) {
        const char* const payload = text.data() + n * kChars;
        ZephLightCommand address;
        address.EffectType = number<2>(payload + 2);
        address.Network = number<3>(payload + 4);
        address.DeviceType = number<2>(payload + 7);
        address.Unit = number<3>(payload + 9);
        address.Circuit = number<3>(payload + 12);
        const std::int32_t start = number<3>(payload + 23);
        const std::int32_t end = number<3>(payload + 26);
        const std::optional<std::int32_t> duration = readDurationMs({payload + 15, 8});
        const bool subGood = address.EffectType >= 0 && address.EffectType <= 3;
        const bool digits = (address.Network | address.DeviceType | address.Unit | address.Circuit | start | end) >= 0;
        const bool named = (address.Network | address.DeviceType | address.Unit) == 0;
        if (number<2>(payload) != 0 || !subGood || !digits || named || !duration) return n;
        const bool scale255 = address.EffectType == 3;
        out[n] = {address, {*duration, intensityOf(start, scale255), intensityOf(end, scale255)}};
    }
    return fits;
}

#ifdef ZEPH_X86_FORMS

// A payload is read as its characters 0..15 (address half) and 13..28 (timing half), so that no byte outside it is
// touched. The shuffles right-align each field in 4 bytes, a three-digit field as 0, hundreds, tens, ones; 0x80 gives
// a zero byte.
alignas(16) constexpr std::uint8_t kAddressShuffle[16] = {0x80, 4, 5,  6,  0x80, 0x80, 7,  8,
                                                          0x80, 9, 10, 11, 0x80, 12,   13, 14};
// One shuffle for each place of the point: 8 bytes of duration without it, then start and end level.
constexpr std::size_t kPointPlaces = 9;
struct TimingShuffles {
    alignas(16) std::uint8_t rows[kPointPlaces][16];
};
constexpr TimingShuffles kTimingShuffles = [] {
    TimingShuffles shuffles{};
    for (unsigned pointAt = 0; pointAt < kPointPlaces; ++pointAt) {
        std::uint8_t* const row = shuffles.rows[pointAt];
        for (unsigned i = 0; i < 8; ++i) {
            const bool moved = i <= pointAt && pointAt < 8;  // digits before the point move up by one
            row[i] = static_cast<std::uint8_t>(!moved ? 2 + i : i == 0 ? 0x80 : 2 + i - 1);
        }
        const std::uint8_t levels[8] = {0x80, 10, 11, 12, 0x80, 13, 14, 15};
        for (unsigned i = 0; i < 8; ++i)
            row[8 + i] = levels[i];
    }
    return shuffles;
}();

// Digit weights: pairs of bytes are weighted and added to 16 bits, pairs of those to 32.
alignas(16) constexpr std::int8_t kFieldWeights[16] = {0, 100, 10, 1, 0, 100, 10, 1, 0, 100, 10, 1, 0, 100, 10, 1};
alignas(16) constexpr std::int8_t kTimingWeights[16] = {10, 1, 10, 1, 10, 1, 10, 1, 0, 100, 10, 1, 0, 100, 10, 1};
alignas(16) constexpr std::int16_t kFieldPairs[8] = {1, 1, 1, 1, 1, 1, 1, 1};
alignas(16) constexpr std::int16_t kTimingPairs[8] = {100, 1, 100, 1, 1, 1, 1, 1};

constexpr unsigned kAddressDigits = 0x7FFF;  // characters 0..14 of the address half
constexpr unsigned kDurationBits = 0xFF;     // of the timing half, shifted down by the two characters before it
static_assert(offsetof(ZephLightCommand, Circuit) == offsetof(ZephLightCommand, Network) + 12);

// cmd 00 and sub 00 to 03 leave only the last digit of the four characters, in the top byte of a little-endian word.
inline bool isLightHead(const char* payload, std::int32_t& sub) noexcept {
    std::uint32_t head;
    std::memcpy(&head, payload, sizeof head);
    head ^= 0x30303030u;
    sub = static_cast<std::int32_t>(head >> 24);
    return (head & 0xFCFFFFFFu) == 0;
}

// The timing half's non-digits: good where they are at most one point within the duration. Gives the point's place.
inline bool isTimingGood(unsigned notDigits, unsigned points, unsigned& pointAt) noexcept {
    const unsigned point = points >> 2 & kDurationBits;
    pointAt = static_cast<unsigned>(std::countr_zero(point | 0x100u));
    return notDigits >> 2 == point && (point & (point - 1)) == 0;
}

inline void putCommand(std::int32_t sub, unsigned pointAt, std::uint64_t durationHalves, std::uint64_t levels,
                       ZephChannelCommand& out) noexcept {
    const auto& intensity = kIntensityTable[sub == 3 ? 1 : 0];
    const auto upper = static_cast<std::int32_t>(durationHalves & 0xFFFFFFFFu);
    const auto lower = static_cast<std::int32_t>(durationHalves >> 32);
    out.Command.CommandType = 0;
    out.Command.EffectType = sub;
    out.Timing = {durationMs(upper * 10'000 + lower, pointAt), intensity[levels & 0xFFFFFFFFu],
                  intensity[levels >> 32]};
}

inline __m128i loadAligned(const void* at) noexcept {
    return _mm_load_si128(static_cast<const __m128i*>(at));
}

// One bit for each character that is a digit.
inline unsigned digitBits(__m128i half, __m128i nine) noexcept {
    return static_cast<unsigned>(_mm_movemask_epi8(_mm_cmpeq_epi8(_mm_min_epu8(half, nine), half)));
}

__attribute__((target("sse4.1"))) std::size_t decodeSse41(std::string_view text, std::size_t most,
                                                          ZephChannelCommand* out) noexcept {
    const __m128i zeroDigit = _mm_set1_epi8('0');
    const __m128i nine = _mm_set1_epi8(9);
    const __m128i point = _mm_set1_epi8('.' - '0');
    const __m128i addressLanes = _mm_setr_epi32(-1, -1, -1, 0);  // network, device type, unit
    const std::size_t fits = std::min(most, text.size() / kChars);
    for (std::size_t n = 0; n < fits; ++n) {
        const char* const payload = text.data() + n * kChars;
        std::int32_t sub = 0;
        if (!isLightHead(payload, sub)) return n;
        const __m128i address = _mm_sub_epi8(_mm_loadu_si128(reinterpret_cast<const __m128i*>(payload)), zeroDigit);
        const __m128i timing = _mm_sub_epi8(_mm_loadu_si128(reinterpret_cast<const __m128i*>(payload + 13)), zeroDigit);
        const auto points = static_cast<unsigned>(_mm_movemask_epi8(_mm_cmpeq_epi8(timing, point)));
        unsigned pointAt = 0;
        if ((digitBits(address, nine) & kAddressDigits) != kAddressDigits) return n;
        if (!isTimingGood(~digitBits(timing, nine) & 0xFFFFu, points, pointAt)) return n;
        const __m128i fields = _mm_madd_epi16(
            _mm_maddubs_epi16(_mm_shuffle_epi8(address, loadAligned(kAddressShuffle)), loadAligned(kFieldWeights)),
            loadAligned(kFieldPairs));
        if (_mm_testz_si128(fields, addressLanes)) return n;
        const __m128i values =
            _mm_madd_epi16(_mm_maddubs_epi16(_mm_shuffle_epi8(timing, loadAligned(kTimingShuffles.rows[pointAt])),
                                             loadAligned(kTimingWeights)),
                           loadAligned(kTimingPairs));
        _mm_storeu_si128(reinterpret_cast<__m128i*>(&out[n].Command.Network), fields);
        putCommand(sub, pointAt, static_cast<std::uint64_t>(_mm_cvtsi128_si64(values)),
                   static_cast<std::uint64_t>(_mm_extract_epi64(values, 1)), out[n]);
    }
    return fits;
}

#endif

}  // namespace

bool hasDecodeForm(DecodeForm form) noexcept {
#ifdef ZEPH_X86_FORMS
    if (form == DecodeForm::Sse41) return __builtin_cpu_supports("sse4.1");
#endif
    return form == DecodeForm::Plain;
}

DecodeRun decodeRunOf(DecodeForm form) noexcept {
#ifdef ZEPH_X86_FORMS
    if (form == DecodeForm::Sse41) return decodeSse41;
#endif
    return decodePlain;
}

DecodeForm fastestDecodeForm() noexcept {
    return hasDecodeForm(DecodeForm::Sse41) ? DecodeForm::Sse41 : DecodeForm::Plain;
}
