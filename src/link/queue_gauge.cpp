#include "link/queue_gauge.h"

#include "util/color.h"

#include <algorithm>

namespace {

std::int32_t colorFor(std::int32_t length) noexcept {
    const std::int32_t tenfold = length * 10;  // exact where a ratio in floating point is not
    if (tenfold > 9 * kQueueGaugeMax) return packColor(255, 0, 0);
    if (tenfold > 7 * kQueueGaugeMax) return packColor(255, 255, 0);
    return packColor(0, 255, 0);
}

}  // namespace

QueueGaugeUpdate ZephUpdateQueueGauge(std::size_t length, bool openGlOutput, QueueGauge& gauge) noexcept {
    QueueGaugeUpdate update;
    if (openGlOutput) return update;
    update.value = static_cast<std::int32_t>(std::min<std::size_t>(length, kQueueGaugeMax));
    const std::int32_t color = colorFor(*update.value);
    if (color != gauge.colorSent) update.color = gauge.colorSent = color;
    return update;
}
