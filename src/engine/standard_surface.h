// The standard drawing surface: lights as ready images, blended over the background picture on a 32-bit frame. The
// calls of a frame are noted and painted at its end: densely lit displays tile by tile, thinly lit ones bulb by bulb.
// One thread; a frame allocates nothing.
#pragma once

#include "engine/frame_plan.h"
#include "engine/light_surface.h"
#include "engine/pixel_store.h"
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
    static constexpr std::int32_t kBandMarginRows = 4;  // bulbs of size 2 are painted whole, over the band's edge

    static constexpr std::int32_t kCoveredMargin = 128;  // pixels; the largest image hangs out of the canvas no farther
    static constexpr std::int32_t coveredWords(std::int32_t width) noexcept {
        return (width + 2 * kCoveredMargin) / 64 + 1;
    }

    enum class BandLight : std::uint8_t {
        None,    // shows the background
        Whole,   // shows the units of lastWhole_: it stays while those do
        Listed,  // shows the squares of lastListed_
        Unknown  // shows other lights
    };
    // Bulbs by band, or by tile, within it in the order of painting.
    struct PartLists {
        std::vector<BulbItem> Items;
        std::vector<std::int32_t> First;  // [part], one more than parts

        std::span<const BulbItem> of(std::size_t part) const noexcept { return of(part, part + 1); }
        std::span<const BulbItem> of(std::size_t part, std::size_t end) const noexcept {
            return itemsOf(Items, First, part, end);
        }
    };
    static std::span<const BulbItem> itemsOf(const std::vector<BulbItem>& items, const std::vector<std::int32_t>& first,
                                             std::size_t part, std::size_t end) noexcept {
        return {items.data() + first[part], static_cast<std::size_t>(first[end] - first[part])};
    }
    // The pixels of a tile that lights can reach, whole cache lines; Left = Right: none.
    struct TileArea {
        RowRange Rows;
        std::int32_t Left = 0;
        std::int32_t Right = 0;
    };

    // What lay under the bulbs of a thinly lit frame, one after the other in the order of painting.
    struct SavedPixels {
        std::vector<std::uint32_t> Pixels;
        std::vector<std::int32_t> End;  // [band + 1]
        std::int32_t Used = 0;
    };
    struct Square {
        std::int32_t Left = 0;  // pixels
        std::int32_t Width = 0;
        std::int32_t Top = 0;
        std::int32_t Bottom = 0;
    };

    void noteUnit(std::int32_t unit, std::uint8_t alpha);
    void noteWhole(std::int32_t unit);
    void listBulb(std::int32_t unit, std::int32_t bulb0);
    void updateSprite(std::int32_t unit, std::int32_t color, ZephRGBData& group);

    void paintNoted();
    bool worthBands() const noexcept;
    template <typename Visit>
    void forEachNoted(Visit visit) const;
    void paintDense();
    bool denseBandChanged(std::size_t band) const noexcept;
    TileArea tileArea(std::size_t tile) const noexcept;
    void paintTileDense(std::size_t tile);
    void paintItemsDense(std::size_t tile, RowRange rows, const PixelTarget& target);
    void paintThin();
    void paintBandThin(std::size_t band);
    bool showsLastList() const noexcept;
    void paintThinAgain();
    void paintBandThinAgain(std::size_t band);
    void findAlone();
    void paintOver();

    std::uint64_t restoreBand(std::size_t band, std::span<const BulbItem> last);
    void saveUnder(const BulbItem& item, RowRange rows);
    void keepSaved(std::size_t band);
    Square squareOf(const BulbItem& item, RowRange rows) const noexcept;
    void fetchItem(const BulbItem& item) const noexcept;
    void fetchTileRow(const TileArea& area, std::int32_t row0) const noexcept;
    RowRange bandRows(std::size_t band) const noexcept;
    std::uint64_t tilesOf(const BulbItem& item) const noexcept;
    void tellBand(std::size_t band);
    void tellTiles(std::size_t band, std::uint64_t tiles);

    const BlendKernels& kernels_;
    std::optional<SurfaceScene> scene_;
    FramePlan plan_;
    std::int64_t thinLimit_ = 0;  // pixels: frames that cost more are painted as dense ones
    ZephRGBBulbCache cache_;
    RGBBulbPool pool_;

    PixelStore frame_;
    PixelStore background_;
    PixelStore tile_;  // one tile under way, with kBandMarginRows above and below and the largest image on either side
    QImage image_;

    // The frame under way. A later pass comes about only when calls leave the planned order or lists overflow.
    std::vector<std::uint8_t> alpha_;          // [unit], 0 = not drawn
    std::vector<std::uint8_t> whole_;          // [unit], alpha_ where its planned items are drawn, else 0
    std::vector<std::uint8_t> spriteChanged_;  // [unit], since the last frame
    bool anySpriteChanged_ = false;
    std::vector<std::int32_t> notedWhole_;  // units, in the order of calls
    std::vector<BulbItem> listed_;          // bulbs that came as lists, in the order of calls
    std::int32_t lastUnit_ = 0;
    std::int64_t litBulbs_ = 0;
    std::int64_t litPixels_ = 0;
    std::int32_t passes_ = 0;
    PartLists bandListed_;  // of a thinly lit frame
    PartLists tileListed_;  // of a densely lit one
    SavedPixels saved_;
    std::vector<QRect> changed_;

    // What the frame before left on the picture.
    std::vector<std::uint8_t> lastAlpha_;
    std::vector<std::uint8_t> lastWhole_;
    PartLists lastListed_;
    SavedPixels lastSaved_;
    std::vector<BandLight> bandLight_;
    std::vector<std::int32_t> lastNotedWhole_;
    // Of the items of lastListed_: 1 = no earlier one of the band lies under any of its pixels, so that what was saved
    // there is the background whatever the others show. Found when a list is painted for the second time.
    std::vector<std::uint8_t> alone_;
    bool aloneFound_ = false;
    std::vector<std::uint64_t> covered_;  // work space of findAlone: a bit a pixel of a band and its margins
    bool lastRepeats_ = false;            // lastWhole_ and the images tell all of it
    bool wholeChanged_ = false;           // the background was replaced
};
