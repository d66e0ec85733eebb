#include "engine/ribbon_motion.h"

#include "util/rounding.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr std::int32_t kMotionStrobe = 11;

// A stretch of the strand, in pixels, both ends included; empty by default.
struct Stretch {
    double low = 1;
    double high = 0;
    bool holds(std::int32_t pixel) const noexcept { return pixel >= low && pixel <= high; }
};

// 100 / n at five decimals, the precision of the ribbon's own controller.
double scaleFor(std::int32_t n) {
    return std::floor(100.0 / n * 1e5 + 0.5) / 1e5;
}

std::int32_t widthUpTo(std::int32_t parm, std::int32_t most) {
    return parm >= 1 && parm <= most ? parm : 0;
}

// Position 99 is the end of the road: 100 cannot be told from it on the controller's dial.
std::int32_t fullAt99(std::int32_t position) {
    return position == 99 ? 100 : position;
}

// A block of a width that ends at the head, from pixel 1 on.
Stretch blockBehind(double head, std::int32_t width, double most) {
    const double high = std::min(head, most);
    return {std::max(head - width, 1.0), high};
}

// The two stretches that a motion without a chase lights. Some limits of the widths (49, 24, 25) look uneven: the
// controllers have them so.
std::array<Stretch, 2> litStretches(const ZephKeshState& ribbon) {
    const std::int32_t position = ribbon.KeshMotionPos;
    const std::int32_t parm = ribbon.KeshMotionParm;
    const bool under99 = position > 0 && position < 99;
    switch (ribbon.KeshMotion) {
    case 1: {  // block from the start
        const std::int32_t width = widthUpTo(parm, 49);
        if (position <= 0 || (position >= 99 && width > 0)) return {};
        if (width == 0) return {Stretch{1, static_cast<double>(position / 2)}, Stretch{}};
        return {blockBehind(position / scaleFor(width + 51), width, 50), Stretch{}};
    }
    case 2: {  // fill from the end
        return {Stretch{51 - fullAt99(position) / 2.0, 50}, Stretch{}};
    }
    case 3:    // two blocks to the middle
    case 7: {  // two blocks in step
        const bool mirrored = ribbon.KeshMotion == 3;
        const std::int32_t width = widthUpTo(parm, mirrored ? 24 : 25);
        if (!under99) return {};
        Stretch block;
        if (width > 0) {
            block = blockBehind(position / scaleFor(width + 25), width, 25);
        } else {
            // Without a width the mirrored pair is one pixel wide and the pair in step a fill: rows of the
            // controller's own table that differ on purpose.
            const double high = position / 4;
            block = {mirrored ? high : 1.0, high};
        }
        return {block, mirrored ? Stretch{51 - block.high, 51 - block.low} : Stretch{25 + block.low, 25 + block.high}};
    }
    case 4: {  // fill from the middle
        const double half = fullAt99(position) / 4.0;
        const double low = 26 - half;
        if (low > 25) return {};
        return {Stretch{low, 25}, Stretch{26, 25 + half}};
    }
    case 8: {  // fill two halves from the end
        const double low = 51 - fullAt99(position) / 4.0;
        if (low > 50) return {};
        return {Stretch{low, 50}, Stretch{low - 25, 25}};
    }
    default:
        return {};
    }
}

bool isChase(std::int32_t motion) {
    return motion == 5 || motion == 6 || motion == 9 || motion == 10;
}
bool isReverse(std::int32_t motion) {
    return motion == 6 || motion == 10;
}

void stepChase(std::int32_t on, std::int32_t off, std::int32_t nowMs, ZephKeshState& ribbon) {
    if (ribbon.ChaseTime == 0) {
        BuildChaseMask(on, off, ribbon);
        ribbon.ChaseStep = -1;
    }
    const bool timed = ribbon.KeshMotion == 5 || ribbon.KeshMotion == 6;
    const bool step = timed ? nowMs - ribbon.ChaseTime > (100 - ribbon.KeshMotionPos) * 4
                            : ribbon.KeshMotionPos != ribbon.KeshMotionPosLast;
    if (step) {
        if (!timed) ribbon.KeshMotionPosLast = ribbon.KeshMotionPos;
        ++ribbon.ChaseStep;
        ribbon.ChaseTime = nowMs;
        BumpChaseMask(ribbon);
    }
    if (ribbon.ChaseStep >= on + off) ribbon.ChaseStep = 0;
}

PixelList chasePixels(const PixelRange& group, std::int32_t nowMs, ZephKeshState& ribbon) {
    PixelList list;
    const std::int32_t on = ribbon.KeshMotionParm / 10;
    const std::int32_t off = ribbon.KeshMotionParm - 10 * on;
    if (on == 0) return list;
    if (off == 0) {
        for (std::int32_t p = group.first; p <= group.last; ++p)
            list.add(p);
        return list;
    }
    stepChase(on, off, nowMs, ribbon);
    const std::int32_t length = on + off;
    const auto lit = [&](std::int32_t place) { return ribbon.ChaseMask[static_cast<std::size_t>(place)]; };
    if (isReverse(ribbon.KeshMotion)) {
        // From the far end, so where bulbs overlap the near one lies on top.
        for (std::int32_t p = group.last; p >= group.first; --p) {
            const std::int32_t place = length - p % length + 1;
            if (lit(place > length ? 1 : place)) list.add(p);
        }
    } else {
        for (std::int32_t p = group.first; p <= group.last; ++p) {
            const std::int32_t place = p % length;
            if (lit(place == 0 ? length : place)) list.add(p);
        }
    }
    return list;
}

PixelRange uncutGroup(std::int32_t t, std::int32_t resolution) noexcept {
    switch (resolution) {
    case 1:
        return {2 * t - 1, 2 * t};
    case 2:
        // Seventeen groups on fifty pixels: the ninth has two.
        if (t == 9) return {25, 26};
        return t < 9 ? PixelRange{3 * (t - 1) + 1, 3 * t} : PixelRange{3 * (t - 1), 3 * t - 1};
    case 3:
        // Sixteen groups, the first and the last of four; a seventeenth draws the last again.
        if (t == 1) return {1, 4};
        return t >= 16 ? PixelRange{47, 50} : PixelRange{3 * (t - 1) + 2, 3 * t + 1};
    case 4:
        return {5 * (t - 1) + 1, 5 * t};
    case 5:
        return {10 * (t - 1) + 1, 10 * t};
    case 6:
        return {25 * (t - 1) + 1, 25 * t};
    case 7:
        return {1, 50};
    default:
        return {t, t};
    }
}

}  // namespace

PixelRange ribbonGroup(std::int32_t triplet, std::int32_t resolution, std::int32_t pointCount) noexcept {
    PixelRange group = uncutGroup(triplet, resolution);
    group.last = std::min({group.last, pointCount, group.first + kMaxRibbonPixels - 1});
    return group;
}

PixelList ReturnKeshBulbLocs(std::int32_t triplet, std::int32_t resolution, std::int32_t pointCount, std::int32_t nowMs,
                             ZephKeshState& ribbon) {
    const PixelRange group = ribbonGroup(triplet, resolution, pointCount);
    if (group.first > group.last) return {};
    if (isChase(ribbon.KeshMotion)) return chasePixels(group, nowMs, ribbon);

    const bool whole = ribbon.KeshMotion == 0 || (ribbon.KeshMotion == kMotionStrobe && ribbon.KeshStrobeOn);
    std::array<Stretch, 2> stretches{};
    if (!whole) stretches = litStretches(ribbon);
    PixelList list;
    for (std::int32_t p = group.first; p <= group.last; ++p) {
        if (whole || stretches[0].holds(p) || stretches[1].holds(p)) list.add(p);
    }
    return list;
}

void ClearKeshParms(ZephKeshState& ribbon) {
    ribbon.ChaseTime = 0;
    ribbon.ChaseStep = 0;
    ribbon.KeshStrobeOn = true;
    ribbon.KeshStrobeNext = 0;
    ribbon.ChaseLength = 0;
}

void BuildChaseMask(std::int32_t on, std::int32_t off, ZephKeshState& ribbon) {
    ribbon.ChaseLength = on + off;
    for (std::int32_t place = 1; place <= ribbon.ChaseLength; ++place) {
        ribbon.ChaseMask[static_cast<std::size_t>(place)] = place > off;
    }
}

void BumpChaseMask(ZephKeshState& ribbon) {
    if (ribbon.ChaseLength < 2) return;
    const auto first = ribbon.ChaseMask.begin() + 1;
    const auto end = first + ribbon.ChaseLength;
    std::rotate(first, end - 1, end);
}

void stepMotionStrobe(std::int32_t nowMs, ZephKeshState& ribbon) {
    if (nowMs <= ribbon.KeshStrobeNext) return;
    if (ribbon.KeshStrobeOn) {
        ribbon.KeshStrobeNext = nowMs - 30 * ribbon.KeshMotionPos + 3010;
        ribbon.KeshStrobeOn = false;
    } else {
        ribbon.KeshStrobeOn = true;
        const std::int32_t flashMs =
            ribbon.KeshMotionParm == 0 ? 25 : roundHalfEven((100 - ribbon.KeshMotionParm) * 8.33 + 10);
        ribbon.KeshStrobeNext = nowMs + flashMs;
    }
}
