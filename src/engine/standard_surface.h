// The standard drawing surface: lights as ready images, blended over the background picture on a 32-bit frame. The
// calls of a frame are noted and painted at its end: densely lit displays band by band, thinly lit ones bulb by bulb.
// One thread; a frame allocates nothing.
#pragma once

#include "engine/frame_plan.h"
#include "engine/light_surface.h"
#include "engine/rgb_bulbs.h"
#include "util/failure.h"

#include <QImage>
#include <QRect>

#include <cstdint>
#include <optional>
#include <span>
#include <vector>

// What a simulation is drawn from. All of it must outlive the surface's use and keep its place; the tables' RGBData
// must come fresh from their build, since the images that it names belong to this surface.
struct SurfaceScene {
    const ZephSimulation& Document;
    const ZephRenderTables& Tables;
    const ZephFixtureStates& States;
    const ZephMasks& Masks;
    const ZephStaticBulbs& Bulbs;
    const QImage& Background;  // the canvas, 1..2500 pixels either way; copied
};

inline constexpr std::int32_t kBandMargin = 128;    // pixels beside a band: the largest image hangs out no farther
inline constexpr std::int32_t kBandMarginRows = 4;  // small bulbs are painted whole, over the band's edge

inline constexpr std::int32_t kCacheLinePixels = 16;

constexpr std::int32_t wholeCacheLines(std::int32_t pixels) noexcept {
    return (pixels + kCacheLinePixels - 1) / kCacheLinePixels * kCacheLinePixels;
}

// Rows of pixels that begin on whole cache lines, with room beside them for the kernels' overreach.
class PixelStore {
public:
    PixelStore() = default;
    PixelStore(PixelStore&&) = default;
    PixelStore& operator=(PixelStore&&) = default;

    void resize(std::int32_t width, std::int32_t height);  // fills with opaque black
    std::uint32_t* row(std::int32_t y) noexcept { return first_ + y * stride_; }
    const std::uint32_t* row(std::int32_t y) const noexcept { return first_ + y * stride_; }
    std::int32_t stride() const noexcept { return stride_; }  // pixels, a multiple of kCacheLinePixels

private:
    std::vector<std::uint32_t> pixels_;
    std::uint32_t* first_ = nullptr;
    std::int32_t stride_ = 0;
};

class StandardSurface : public LightSurface {
public:
    explicit StandardSurface(const BlendKernels& kernels = fastestBlendKernels()) : kernels_(kernels) {}

    // At entry into simulation, before the first frame; the frame then shows the background alone. False, with a
    // report, if the canvas is empty or too large or the tables' images belong to another surface; the surface then
    // draws nothing.
    [[nodiscard]] bool prepare(const SurfaceScene& scene, FailureReport& failures);

    // Gives all storage back; until the next prepare nothing is drawn.
    void release();

    // A new background picture of the same size, in the middle of a simulation; until the next frame it shows
    // alone. False if the size differs.
    [[nodiscard]] bool setBackground(const QImage& background);

    void beginFrame() override;
    void drawChannel(const ChannelDraw& draw) override;
    void drawGroup(const GroupDraw& draw, ZephRGBData& group) override;
    void endFrame() override;

    // The frame, Format_RGB32, canvas size; a view of the surface's own pixels, valid until prepare or release.
    const QImage& image() const noexcept { return image_; }

    // The parts of the frame that the last endFrame may have changed; empty if it is the same picture.
    std::span<const QRect> changedRects() const noexcept { return changed_; }

    const ZephRGBBulbCache& bulbCache() const noexcept { return cache_; }

private:
    struct NotedUnit {  // one call, in the order of calls
        std::int32_t Unit;
        std::int32_t FirstListed;  // into listed_; -1 = the unit's own runs
        std::int32_t ListedCount;
    };
    struct ListedBulb {
        BulbPlace Place;
        std::int32_t Sprite;
        std::int32_t Unit;
        std::uint8_t Alpha;
    };
    enum class BandLight : std::uint8_t {
        None,    // shows the background
        Runs,    // shows the runs of lastAlpha_: it stays while those do
        Unknown  // shows other lights
    };

    void noteUnit(std::int32_t unit);
    void noteRuns(std::int32_t unit, std::uint8_t alpha);
    void listBulb(std::int32_t unit, std::int32_t bulb0, std::uint8_t alpha);
    void updateSprite(const PlanUnit& planned, std::int32_t color, ZephRGBData& group);
    void paintNoted();
    bool worthBands() const noexcept;

    void paintBands();
    void sortListedIntoBands();
    bool bandChanged(std::size_t band) const noexcept;
    bool paintBand(std::size_t band);

    void paintSquares();
    void paintSquare(std::int32_t sprite, std::uint8_t alpha, const BulbSquare& square);
    void noteLit(const BulbSquare& square);
    void restoreLit();
    void restoreSquare(const BulbSquare& square);
    void restoreBand(std::size_t band);
    QRect bandRect(std::size_t band) const;
    void markUnitTiles(const PlanUnit& unit);
    void collectTiles();

    const BlendKernels& kernels_;
    std::optional<SurfaceScene> scene_;
    FramePlan plan_;
    ZephRGBBulbCache cache_;
    RGBBulbPool pool_;

    PixelStore frame_;
    PixelStore background_;
    PixelStore band_;
    QImage image_;

    // The frame under way. A later pass comes about only when calls leave the planned order or lists overflow.
    std::vector<std::uint8_t> alpha_;          // [unit], 0 = its runs are not painted
    std::vector<std::uint8_t> spriteChanged_;  // [unit], since the last frame
    bool anySpriteChanged_ = false;
    std::vector<NotedUnit> noted_;
    std::vector<ListedBulb> listed_;
    std::int64_t litBulbs_ = 0;
    std::int64_t litPixels_ = 0;
    std::int32_t passes_ = 0;
    std::vector<std::int32_t> bandListed_;       // into listed_, by band
    std::vector<std::int32_t> firstBandListed_;  // [band], one more than bands
    std::vector<std::uint64_t> tiles_;           // [row of tiles], a bit for each that changed
    std::vector<QRect> changed_;

    // What the frame before left on the picture.
    std::vector<std::uint8_t> lastAlpha_;
    std::vector<BandLight> bandLight_;
    std::vector<BulbSquare> lit_;
    std::vector<std::int32_t> litUnits_;  // whose runs were painted square by square, in the first pass
    bool wholeChanged_ = true;            // the frame under it was replaced
    bool lastRepeats_ = false;            // lastAlpha_ and the images tell all of it
};
