#include "shell/window_place.h"

#include "util/units.h"

#include <algorithm>

namespace {

// The first pixel of a stretch of this length that lies within least..most.
int movedInside(int first, int length, int least, int most) {
    return std::max(least, std::min(first, most - length + 1));
}

}  // namespace

QRect ZephWindowPlace(const ZephSettings& settings, const QRect& available) {
    const int width = std::min(settings.Width / TwipsPerPixelX, available.width());
    const int height = std::min(settings.Height / TwipsPerPixelY, available.height());
    const int left = movedInside(settings.Left / TwipsPerPixelX, width, available.left(), available.right());
    const int top = movedInside(settings.Top / TwipsPerPixelY, height, available.top(), available.bottom());
    return {left, top, width, height};
}

void ZephKeepWindowPlace(const QRect& place, int state, ZephSettings& settings) {
    settings.Left = place.left() * TwipsPerPixelX;
    settings.Top = place.top() * TwipsPerPixelY;
    settings.Width = place.width() * TwipsPerPixelX;
    settings.Height = place.height() * TwipsPerPixelY;
    settings.State = state;
}
