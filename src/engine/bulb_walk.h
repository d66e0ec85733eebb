// The walk along the polyline of a light string: where the bulbs of one of its channels hang. The one place of that
// rule; the simulation places its bulbs by it, the editor draws by it. Coordinates are pixels.
#pragma once

#include "model/simulation.h"
#include "util/rounding.h"

#include <cmath>
#include <cstdint>

// A light string of the largest canvas holds fewer bulbs than this on a channel (255 diagonals at a pitch of one
// pixel). Only a damaged file, with points millions of pixels away, gets here; its walk ends at the limit.
inline constexpr std::int32_t kMaxWalkedBulbs = 1 << 20;

struct WalkedBulb {
    std::int32_t X = 0;  // pixels, the centre of the bulb
    std::int32_t Y = 0;
    std::int32_t ColorIndex = 1;  // 1..Sub_Parm on a Multi Color channel, counted anew at each stroke; else 1
};

// The rhythm of one channel along the line: all channels share the line and their bulbs take turns on it.
struct BulbRhythm {
    bool walks = false;       // false: nothing hangs here (pitch below 1, or no such channel)
    double pitch = 0;         // pixels from bulb to bulb
    double offset = 0;        // pixels from the start of a stroke to the channel's first bulb
    double gap = 0;           // pixels that the other channels take in each turn
    std::int32_t colors = 1;  // bulbs in each turn of the channel
};

// Channels whose bulbs lie along the line: 1 for an RGB fixture and for one without channels, else ChannelCount, kept
// within 1..16.
std::int32_t walkedChannels(const ZephFixture& fixture) noexcept;

// Colours of a Multi Color channel, Sub_Parm kept within 1..5; 1 for any other channel.
std::int32_t multiColors(const ZephChannel& channel) noexcept;

// PointCount kept within 0..256.
std::int32_t usedPoints(const ZephFixture& fixture) noexcept;

// channel 1..walkedChannels; outside it nothing hangs.
BulbRhythm bulbRhythm(const ZephFixture& fixture, std::int32_t channel) noexcept;

// Twips to the nearest pixel, ties to even. The points of strings are rounded so; those of single bulbs are cut off in
// simulation.
std::int32_t roundedPixelX(std::int32_t twips) noexcept;
std::int32_t roundedPixelY(std::int32_t twips) noexcept;

// Calls visit(const WalkedBulb&) for each bulb of the channel, in order along the line. Allocates nothing.
template <typename Visit>
void walkBulbs(const ZephFixture& fixture, std::int32_t channel, Visit&& visit) {
    const BulbRhythm rhythm = bulbRhythm(fixture, channel);
    const std::int32_t points = usedPoints(fixture);
    if (!rhythm.walks || points < 2) return;

    double x = roundedPixelX(fixture.DrawPoints[1].X);
    double y = roundedPixelY(fixture.DrawPoints[1].Y);
    double remaining = rhythm.offset;
    std::int32_t color = 1;
    std::int32_t placed = 0;
    for (std::int32_t p = 2; p <= points; ++p) {
        const ZephDrawPoint& point = fixture.DrawPoints[p];
        const double nextX = roundedPixelX(point.X);
        const double nextY = roundedPixelY(point.Y);
        if (point.Type == kPointMove) {
            color = 1;
            remaining = rhythm.offset;
        } else {
            const double dx = nextX - x;
            const double dy = nextY - y;
            const double length = std::sqrt(dx * dx + dy * dy);
            if (length > 0 && length < remaining) {
                remaining -= length;
            } else if (length > 0) {
                double dist = remaining;
                do {
                    if (++placed > kMaxWalkedBulbs) return;
                    visit(WalkedBulb{roundHalfEven(x + dx * dist / length), roundHalfEven(y + dy * dist / length),
                                     color});
                    // A turn ends with the last colour; the bulbs of the other channels come before the next one.
                    if (++color > rhythm.colors) {
                        color = 1;
                        dist += rhythm.gap;
                    }
                    dist += rhythm.pitch;
                } while (dist < length);
                remaining = dist - length;
            }
        }
        x = nextX;
        y = nextY;
    }
}
