// Between the beginning of a frame and its end nothing is allocated: not by us, and not by what we call.
#include "display.h"
#include "engine/standard_surface.h"
#include "tests/support/engine_rig.h"
#include "tests/support/masks.h"

namespace {

thread_local int allocations = 0;

}  // namespace

// What every form of new, and Qt's own arrays, end in. The C library finds these before its own.
extern "C" {
void* __libc_malloc(std::size_t) noexcept;
void* __libc_calloc(std::size_t, std::size_t) noexcept;
void* __libc_realloc(void*, std::size_t) noexcept;
void* __libc_memalign(std::size_t, std::size_t) noexcept;

void* malloc(std::size_t size) noexcept {
    ++allocations;
    return __libc_malloc(size);
}
void* calloc(std::size_t count, std::size_t size) noexcept {
    ++allocations;
    return __libc_calloc(count, size);
}
void* realloc(void* block, std::size_t size) noexcept {
    ++allocations;
    return __libc_realloc(block, size);
}
void* aligned_alloc(std::size_t alignment, std::size_t size) noexcept {
    ++allocations;
    return __libc_memalign(alignment, size);
}
}

namespace {

// The example, which has everything, on the standard surface, driven at random.
struct BusyYard : EngineRig {
    BusyYard() {
        buildDisplay(*simulation);
        ZephFixture& flood = *std::ranges::find(simulation->Fixtures, kFixtureFlood, &ZephFixture::Fixture_Type);
        flood.ChannelCount = 0;
        makeRgb(flood, 200, 1);
        build();
        ZephRebuildStaticFixtureBulbs(*simulation, masks(), *bulbs);
        picture =
            QImage(widthPixels(simulation->Background), heightPixels(simulation->Background), QImage::Format_RGB32);
        picture.fill(qRgb(20, 30, 60));
        EXPECT_TRUE(canvas.prepare({*simulation, tables, *states, masks(), *bulbs, picture}, failures));
    }

    // Fades, shimmer and twinkle on one channel in so many; effects, motions and resolutions on the ribbons.
    void fileCommands(int oneIn, std::int32_t nowMs) {
        const auto pick = [&](int low, int high) { return ZephReturnRandomNumber(low, high, seeded); };
        for (auto key = tables.Keys.begin() + 1; key != tables.Keys.end(); ++key) {
            if (pick(1, oneIn) > 1) continue;
            // A virtual channel's address is its circuit alone, so any key can be written as one.
            ZephAddLightCommand({0, pick(0, 2), 0, kDeviceNone, 0, *key},
                                {pick(0, 1) * pick(0, 400), pick(0, 100), pick(0, 100)}, nowMs, tables);
        }
    }

    std::unique_ptr<ZephStaticBulbs> bulbs = std::make_unique<ZephStaticBulbs>();
    QImage picture;
    StandardSurface canvas;
    SeededRandom seeded{11};
};

}  // namespace

TEST(Frames, AllocateNothing) {
    BusyYard yard;
    RenderContext run{*yard.simulation, yard.curve,  yard.tables, *yard.states,
                      yard.clocks,      yard.seeded, yard.canvas, yard.failures};
    allocations = 0;
    const QImage empty = yard.canvas.image().copy();
    ASSERT_GT(allocations, 0) << "allocations are not seen, so none would be missed";
    int changed = 0;
    for (int frame = 0; frame < 400; ++frame) {
        const std::int32_t nowMs = EngineRig::kStart + 9 * frame;
        allocations = 0;
        // Hardly any before the first frame, so that no room is made by it; then everything, a few, and hardly any.
        constexpr std::array kOneIn{100, 1, 3, 3, 1, 3, 100, 1, 100, 100};
        if (frame % 40 == 0) yard.fileCommands(kOneIn[static_cast<std::size_t>(frame / 40)], nowMs);
        yard.clocks.ShimmerClock += 9;
        ZephRenderLights(nowMs, run);
        ASSERT_TRUE(frame == 0 || allocations == 0) << "frame " << frame;
        changed += yard.canvas.changedRects().empty() ? 0 : 1;
    }
    EXPECT_GT(changed, 200);
    EXPECT_NE(yard.canvas.image(), empty);
    EXPECT_TRUE(yard.failures.reports.empty());
}
