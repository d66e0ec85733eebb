// The blend kernels for processors with AVX2. Hard masks: sixteen channels at a time in 16 bits, since a covered pixel
// comes to (s x alpha + d x (255 - alpha)) / 255. Soft ones: sourceAlpha x alpha is split into 255 x whole - part,
// which keeps both divisions by 255 within 16 bits. Division by 255, cut off, is exact in the upper half of a product
// with 32897, shifted by 7 (for any 16-bit number).
#include "engine/blend.h"

#include <algorithm>

#if defined(__x86_64__)

#include <immintrin.h>

#define ZEPH_AVX2 __attribute__((target("avx2")))
#define ZEPH_AVX2_INLINE __attribute__((target("avx2"), always_inline)) inline

namespace {

constexpr int kBlock = 8;  // pixels

ZEPH_AVX2_INLINE __m256i load(const std::uint32_t* from) noexcept {
    return _mm256_loadu_si256(reinterpret_cast<const __m256i*>(from));
}
ZEPH_AVX2_INLINE void store(std::uint32_t* to, __m256i pixels) noexcept {
    _mm256_storeu_si256(reinterpret_cast<__m256i*>(to), pixels);
}
ZEPH_AVX2_INLINE __m256i cutBy255(__m256i words) noexcept {
    return _mm256_srli_epi16(_mm256_mulhi_epu16(words, _mm256_set1_epi16(static_cast<short>(32897))), 7);
}

// What one colour at one alpha adds and keeps.
struct HardBlend {
    __m256i add;   // s x alpha + 127, four channels over and over
    __m256i keep;  // 255 - alpha
};

ZEPH_AVX2_INLINE HardBlend hardBlend(std::uint32_t color, std::uint8_t alpha) noexcept {
    const __m256i channels = _mm256_unpacklo_epi8(_mm256_set1_epi32(static_cast<int>(color)), _mm256_setzero_si256());
    const __m256i scaled = _mm256_mullo_epi16(channels, _mm256_set1_epi16(alpha));
    return {_mm256_add_epi16(scaled, _mm256_set1_epi16(127)), _mm256_set1_epi16(static_cast<short>(255 - alpha))};
}

// Eight pixels, all as if covered.
ZEPH_AVX2_INLINE __m256i blendAll(__m256i destination, const HardBlend& blend) noexcept {
    const __m256i zero = _mm256_setzero_si256();
    const __m256i low = _mm256_unpacklo_epi8(destination, zero);
    const __m256i high = _mm256_unpackhi_epi8(destination, zero);
    return _mm256_packus_epi16(cutBy255(_mm256_add_epi16(_mm256_mullo_epi16(low, blend.keep), blend.add)),
                               cutBy255(_mm256_add_epi16(_mm256_mullo_epi16(high, blend.keep), blend.add)));
}

ZEPH_AVX2_INLINE void blendBlock(const std::uint32_t* under, std::uint32_t* to, __m256i lanes,
                                 const HardBlend& blend) noexcept {
    const __m256i destination = load(under);
    store(to, _mm256_blendv_epi8(destination, blendAll(destination, blend), lanes));
}

// Two rows of four pixels, the first of them at start.
ZEPH_AVX2_INLINE void blendRowPair(const PixelTarget& target, std::ptrdiff_t start, __m256i lanes,
                                   const HardBlend& blend) noexcept {
    const auto* upper = reinterpret_cast<const __m128i*>(target.Under + start);
    const auto* lower = reinterpret_cast<const __m128i*>(target.Under + start + target.Stride);
    const __m256i destination =
        _mm256_inserti128_si256(_mm256_castsi128_si256(_mm_loadu_si128(upper)), _mm_loadu_si128(lower), 1);
    const __m256i result = _mm256_blendv_epi8(destination, blendAll(destination, blend), lanes);
    _mm_storeu_si128(reinterpret_cast<__m128i*>(target.Origin + start), _mm256_castsi256_si128(result));
    _mm_storeu_si128(reinterpret_cast<__m128i*>(target.Origin + start + target.Stride),
                     _mm256_extracti128_si256(result, 1));
}

ZEPH_AVX2_INLINE bool wholeWithin(const BulbPlace& place, std::int32_t side, RowRange rows) noexcept {
    return place.Y >= rows.Top && place.Y + side <= rows.Bottom;
}

ZEPH_AVX2 void blendHardRows(const BulbMask& mask, const HardBlend& blend, const BulbPlace& place, RowRange rows,
                             const PixelTarget& target) noexcept {
    const std::int32_t first = std::max(0, rows.Top - place.Y);
    const std::int32_t end = std::min(2 * mask.Size, rows.Bottom - place.Y);
    const std::uint32_t* lanes = mask.Lanes.data() + first * mask.Stride;
    std::ptrdiff_t start = (place.Y + first) * target.Stride + place.X;
    for (std::int32_t y = first; y < end; ++y) {
        if (mask.Stride < kBlock) {
            alignas(32) std::uint32_t row[kBlock] = {};
            std::copy_n(lanes, mask.Stride, row);
            blendBlock(target.Under + start, target.Origin + start, load(row), blend);
        } else {
            for (std::int32_t x = 0; x < mask.Stride; x += kBlock) {
                blendBlock(target.Under + start + x, target.Origin + start + x, load(lanes + x), blend);
            }
        }
        lanes += mask.Stride;
        start += target.Stride;
    }
}

ZEPH_AVX2 void blendHardBulbs(const BulbSprite& sprite, std::uint8_t alpha, std::span<const BulbPlace> places,
                              RowRange rows, const PixelTarget& target) noexcept {
    const BulbMask& mask = *sprite.Mask;
    const std::int32_t side = 2 * mask.Size;
    const HardBlend blend = hardBlend(sprite.Color, alpha);
    if (mask.Size == 1) {
        const __m256i lanes = load(mask.Lanes.data());
        for (const BulbPlace& place : places) {
            if (wholeWithin(place, side, rows)) {
                blendRowPair(target, place.Y * target.Stride + place.X, lanes, blend);
            } else {
                blendHardRows(mask, blend, place, rows, target);
            }
        }
        return;
    }
    if (mask.Size == 2) {
        const __m256i upper = load(mask.Lanes.data());
        const __m256i lower = load(mask.Lanes.data() + kBlock);
        for (const BulbPlace& place : places) {
            if (!wholeWithin(place, side, rows)) {
                blendHardRows(mask, blend, place, rows, target);
                continue;
            }
            const std::ptrdiff_t start = place.Y * target.Stride + place.X;
            blendRowPair(target, start, upper, blend);
            blendRowPair(target, start + 2 * target.Stride, lower, blend);
        }
        return;
    }
    for (const BulbPlace& place : places)
        blendHardRows(mask, blend, place, rows, target);
}

// Four pixels of a soft image as sixteen words.
struct SoftHalf {
    __m256i add;    // s x alpha + 127
    __m256i whole;  // 255 - ceiling of sourceAlpha x alpha / 255
    __m256i part;   // what that ceiling is too high by, 0..254
};

ZEPH_AVX2_INLINE SoftHalf softHalf(__m256i source, __m256i alpha) noexcept {
    // The alpha word of each pixel in all its four words.
    const __m256i sourceAlpha = _mm256_shufflehi_epi16(_mm256_shufflelo_epi16(source, 0xFF), 0xFF);
    const __m256i product = _mm256_mullo_epi16(sourceAlpha, alpha);
    const __m256i ceiling = cutBy255(_mm256_add_epi16(product, _mm256_set1_epi16(254)));
    const __m256i scaled = _mm256_sub_epi16(_mm256_slli_epi16(ceiling, 8), ceiling);
    return {_mm256_add_epi16(_mm256_mullo_epi16(source, alpha), _mm256_set1_epi16(127)),
            _mm256_sub_epi16(_mm256_set1_epi16(255), ceiling), _mm256_sub_epi16(scaled, product)};
}

ZEPH_AVX2_INLINE __m256i blendSoftHalf(__m256i destination, const SoftHalf& soft) noexcept {
    const __m256i carried =
        cutBy255(_mm256_add_epi16(_mm256_mullo_epi16(destination, soft.part), _mm256_set1_epi16(127)));
    const __m256i sum = _mm256_add_epi16(soft.add, _mm256_mullo_epi16(destination, soft.whole));
    return cutBy255(_mm256_add_epi16(sum, carried));
}

ZEPH_AVX2_INLINE void blendSoftBlock(const PixelTarget& target, std::ptrdiff_t start, const SoftHalf& low,
                                     const SoftHalf& high) noexcept {
    const __m256i zero = _mm256_setzero_si256();
    const __m256i destination = load(target.Under + start);
    store(target.Origin + start, _mm256_packus_epi16(blendSoftHalf(_mm256_unpacklo_epi8(destination, zero), low),
                                                     blendSoftHalf(_mm256_unpackhi_epi8(destination, zero), high)));
}

// A flood's rows are the same from above and from below, so what a row of the image comes to serves two rows of pixels.
ZEPH_AVX2 void blendSoftBulbs(const BulbSprite& sprite, std::uint8_t alpha, std::span<const BulbPlace> places,
                              RowRange rows, const PixelTarget& target) noexcept {
    const BulbMask& mask = *sprite.Mask;
    const __m256i zero = _mm256_setzero_si256();
    const __m256i alphas = _mm256_set1_epi16(alpha);
    for (const BulbPlace& place : places) {
        const std::ptrdiff_t corner = place.Y * target.Stride + place.X;
        for (std::int32_t y = 0; y < mask.Size; ++y) {
            const std::int32_t mirror = 2 * mask.Size - 1 - y;
            const bool drawUpper = place.Y + y >= rows.Top && place.Y + y < rows.Bottom;
            const bool drawLower = place.Y + mirror >= rows.Top && place.Y + mirror < rows.Bottom;
            if (!drawUpper && !drawLower) continue;
            const std::uint32_t* from = sprite.Pixels + y * mask.Stride;
            const std::ptrdiff_t upper = corner + y * target.Stride;
            const std::ptrdiff_t lower = corner + mirror * target.Stride;
            const MaskBlocks blocks = mask.Blocks[static_cast<std::size_t>(y)];
            for (std::int32_t x = kBlock * blocks.First; x < kBlock * blocks.End; x += kBlock) {
                const __m256i source = load(from + x);
                const SoftHalf low = softHalf(_mm256_unpacklo_epi8(source, zero), alphas);
                const SoftHalf high = softHalf(_mm256_unpackhi_epi8(source, zero), alphas);
                if (drawUpper) blendSoftBlock(target, upper + x, low, high);
                if (drawLower) blendSoftBlock(target, lower + x, low, high);
            }
        }
    }
}

ZEPH_AVX2 void blendBulbs(const BulbSprite& sprite, std::uint8_t alpha, std::span<const BulbPlace> places,
                          RowRange rows, const PixelTarget& target) noexcept {
    if (sprite.Mask->Soft) {
        blendSoftBulbs(sprite, alpha, places, rows, target);
    } else {
        blendHardBulbs(sprite, alpha, places, rows, target);
    }
}

ZEPH_AVX2 void streamRow(const std::uint32_t* from, std::uint32_t* to, std::int32_t pixels) noexcept {
    for (std::int32_t x = 0; x < pixels; x += 2 * kBlock) {
        const __m256i first = _mm256_load_si256(reinterpret_cast<const __m256i*>(from + x));
        const __m256i second = _mm256_load_si256(reinterpret_cast<const __m256i*>(from + x + kBlock));
        _mm256_stream_si256(reinterpret_cast<__m256i*>(to + x), first);
        _mm256_stream_si256(reinterpret_cast<__m256i*>(to + x + kBlock), second);
    }
}

void endStreaming() noexcept {
    _mm_sfence();
}

}  // namespace

const BlendKernels kAvx2Kernels{blendBulbs, streamRow, endStreaming};

bool avx2Available() noexcept {
    return __builtin_cpu_supports("avx2") != 0;
}

#else

bool avx2Available() noexcept {
    return false;
}

const BlendKernels kAvx2Kernels = blendKernels(BlendForm::Portable);

#endif
