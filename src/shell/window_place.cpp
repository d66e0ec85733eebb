#include "shell/window_place.h"

#include "util/units.h"

#include <algorithm>

namespace {

// The first pixel of a stretch of this length that lies within least..most.
int movedInside(int first, int length, int least, int most) {
    return std::max(least, std::min(first, most - length + 1));
}

}  // namespace

QRect placedInside(const QRect& wanted, const QRect& available) {
    const int width = std::min(wanted.width(), available.width());
    const int height = std::min(wanted.height(), available.height());
    const int left = movedInside(wanted.left(), width, available.left(), available.right());
    const int top = movedInside(wanted.top(), height, available.top(), available.bottom());
    return {left, top, width, height};
}

QRect ZephWindowPlace(const ZephSettings& settings, const QRect& available) {
    const QRect stored(settings.Left / TwipsPerPixelX, settings.Top / TwipsPerPixelY, settings.Width / TwipsPerPixelX,
                       settings.Height / TwipsPerPixelY);
    return placedInside(stored, available);
}

void ZephKeepWindowPlace(const QRect& place, int state, ZephSettings& settings) {
    settings.Left = place.left() * TwipsPerPixelX;
    settings.Top = place.top() * TwipsPerPixelY;
    settings.Width = place.width() * TwipsPerPixelX;
    settings.Height = place.height() * TwipsPerPixelY;
    settings.State = state;
}
