#include "programs/tool/demo_show.h"

#include "programs/tool/show_scenes.h"

#include <algorithm>
#include <array>

namespace {

struct Act {
    void (*scene)(ShowStage& stage, ShowSpan span);
    double share;  // of the show's length
};

constexpr std::array kActs{Act{washScene, 0.14}, Act{sweepScene, 0.16},  Act{spiralScene, 0.18}, Act{ribbonScene, 0.22},
                           Act{beatScene, 0.07}, Act{finaleScene, 0.13}, Act{fadeOutScene, 0.10}};

}  // namespace

std::vector<CapturePiece> ZephMakeDemoShow(const ShowCast& cast, std::int32_t lengthMs) {
    const std::int32_t length = std::clamp(lengthMs, kShortestShowMs, kLongestShowMs);
    ShowTimeline timeline(cast);
    ShowStage stage(cast, timeline);
    const ShowSpan whole{0, length};
    double start = 0;
    for (const Act& act : kActs) {
        act.scene(stage, {whole.at(start), whole.at(start + act.share)});
        start += act.share;
    }
    return timeline.pieces(length);
}
