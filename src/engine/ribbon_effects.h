// The seven magic channels of a ribbon: a value sent to one changes how the ribbon renders, instead of lighting a bulb.
#pragma once

#include "engine/render_context.h"

// One pass of a magic slot. Gives true where the channel's step counts as taken.
// value 0..100; elapsed: ms since the entry's last step; first: 2 on the first pass of a command, else 0.
bool ProcessKeshMagicChannel(const ZephRenderSlot& slot, std::int32_t value, std::int32_t elapsed, std::int32_t first,
                             std::int32_t nowMs, RenderContext& context);

// 2 for an effect that twinkles, -1 for one that dazzles.
std::int32_t KeshTwinkleOrDazzle(std::int32_t effect);
