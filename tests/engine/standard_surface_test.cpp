#include "engine/standard_surface.h"
#include "tests/support/drawing_stage.h"
#include "tests/support/recording_host.h"
#include "tests/support/reference_surface.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

namespace {

// Pixels that differ from what was there before must lie within the rectangles told.
bool changesAreTold(const QImage& before, const StandardSurface& surface) {
    const QImage& after = surface.image();
    for (int y = 0; y < after.height(); ++y) {
        for (int x = 0; x < after.width(); ++x) {
            if (before.pixel(x, y) == after.pixel(x, y)) continue;
            const auto holds = [&](const QRect& rect) { return rect.contains(x, y); };
            if (std::none_of(surface.changedRects().begin(), surface.changedRects().end(), holds)) return false;
        }
    }
    return true;
}

void comparePictures(std::uint64_t seed, const BlendKernels& kernels) {
    RandomStage stage(seed);
    ZephRenderTables fastTables = stage.tables;
    ZephRenderTables plainTables = stage.tables;
    CollectingFailures report;
    StandardSurface fast(kernels);
    ASSERT_TRUE(fast.prepare(stage.scene(fastTables), report));
    ReferenceSurface plain(stage.scene(plainTables));

    std::vector<Call> calls;
    for (int n = 0; n < 10; ++n) {
        constexpr std::array kShares{100, 5, 40, 0, 90};
        const std::int32_t kind = stage.pick(1, 6);
        if (kind > 1) calls = stage.frame(kShares[static_cast<std::size_t>(stage.pick(0, 4))]);
        if (kind == 2 && calls.size() > 1) std::reverse(calls.begin(), calls.end());
        if (kind == 3) calls.insert(calls.end(), calls.begin(), calls.begin() + std::ssize(calls) / 2);
        if (kind == 4 && n > 4) {
            stage.background = noisyPicture(stage.background.width(), stage.background.height(), stage.random());
            ASSERT_TRUE(fast.setBackground(stage.background));
            plain.setBackground(stage.background);
        }
        const QImage before = fast.image().copy();
        play(calls, fastTables, fast);
        play(calls, plainTables, plain);
        ASSERT_EQ(fast.image(), plain.image()) << "seed " << seed << " frame " << n << " kind " << kind;
        ASSERT_TRUE(changesAreTold(before, fast)) << "seed " << seed << " frame " << n;
    }
}

}  // namespace

TEST(StandardSurface, ShowsTheSamePixelsAsTheReference) {
    for (std::uint64_t seed = 1; seed <= 120; ++seed) {
        comparePictures(seed, fastestBlendKernels());
        if (HasFatalFailure()) return;
    }
    for (std::uint64_t seed = 121; seed <= 140; ++seed) {
        comparePictures(seed, blendKernels(BlendForm::Portable));
        if (HasFatalFailure()) return;
    }
}
