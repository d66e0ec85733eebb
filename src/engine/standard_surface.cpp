#include "engine/standard_surface.h"

#include <algorithm>

namespace {

constexpr std::size_t kLeastListed = 1024;
constexpr std::size_t kMostRectsOfBand = static_cast<std::size_t>(kMaxCanvasPixels) / 64 / 2 + 2;

std::int64_t reachedPixels(const FramePlan& plan) noexcept {
    std::int64_t pixels = 0;
    for (const ColumnRange& columns : plan.BandColumns)
        pixels += std::max(0, columns.Right - columns.Left) * kBandRows;
    return pixels;
}

}  // namespace

bool StandardSurface::prepare(const SurfaceScene& scene, FailureReport& failures) try {
    release();
    const std::int32_t width = scene.Background.width();
    const std::int32_t height = scene.Background.height();
    require(width >= 1 && height >= 1 && width <= kMaxCanvasPixels && height <= kMaxCanvasPixels,
            "The canvas is empty or too large");
    for (const ZephRGBData& group : scene.Tables.RGBData) {
        require(group.Bulb == 0, "The render table holds images of another run");
    }

    plan_ = makeFramePlan(scene.Document, scene.Tables, scene.States, scene.Masks, scene.Bulbs, width, height);
    thinLimit_ = reachedPixels(plan_) * 3 / 4;
    pool_.reserve(plan_.Groups, plan_.FloodGroups, plan_.MaxFloodSize);
    frame_.resize(width, height);
    background_.resize(width, height);
    tile_.resize(plan_.TileWidth, kBandRows + 2 * kBandMarginRows, wholeCacheLines(plan_.MaxSide));
    image_ = QImage(reinterpret_cast<uchar*>(frame_.row(0)), width, height,
                    frame_.stride() * static_cast<qsizetype>(sizeof(std::uint32_t)), QImage::Format_RGB32);

    const auto bands = static_cast<std::size_t>(plan_.BandCount);
    const std::size_t listed = std::max(kLeastListed, 2 * static_cast<std::size_t>(plan_.ListedBulbs));
    const std::size_t bandsOfBulb = static_cast<std::size_t>(plan_.MaxSide / kBandRows + 2);
    for (std::vector<std::uint8_t>* byUnit : {&alpha_, &whole_, &lastAlpha_, &lastWhole_, &spriteChanged_}) {
        byUnit->assign(plan_.Units.size(), 0);
    }
    notedWhole_.reserve(plan_.Units.size());
    lastNotedWhole_.reserve(plan_.Units.size());
    listed_.reserve(listed);
    for (PartLists* lists : {&bandListed_, &lastListed_}) {
        lists->Items.assign(plan_.TileItems.size() + listed_.capacity() * bandsOfBulb, {});
        lists->First.assign(bands + 1, 0);
    }
    constexpr std::size_t kTileColumnsOfBulb = 2;  // no image is as wide as a tile
    tileListed_.Items.assign(listed_.capacity() * bandsOfBulb * kTileColumnsOfBulb, {});
    tileListed_.First.assign(plan_.FirstTileItem.size(), 0);
    alone_.assign(lastListed_.Items.size(), 0);
    covered_.assign(static_cast<std::size_t>(kBandRows * coveredWords(plan_.Width)), 0);
    for (SavedPixels* saved : {&saved_, &lastSaved_}) {
        // A bulb of the smallest size saves twice its pixels.
        saved->Pixels.resize(2 * static_cast<std::size_t>(thinLimit_));
        saved->End.assign(bands + 1, 0);
    }
    changed_.reserve(2 + bands * kMostRectsOfBand);
    bandLight_.assign(bands, BandLight::None);
    scene_.emplace(scene);
    return setBackground(scene.Background);
} catch (...) {
    release();
    reportCaughtFailure(failures, "modZephRenderMainEngine", __func__, 0);
    return false;
}

void StandardSurface::release() {
    scene_.reset();
    plan_ = {};
    cache_ = {};
    pool_ = {};
    image_ = {};
    frame_ = {};
    background_ = {};
    tile_ = {};
    bandListed_ = {};
    tileListed_ = {};
    lastListed_ = {};
    lastNotedWhole_.clear();
    alone_.clear();
    covered_.clear();
    saved_ = {};
    lastSaved_ = {};
    notedWhole_.clear();
    listed_.clear();
    changed_.clear();
}

bool StandardSurface::setBackground(const QImage& background) {
    if (!scene_ || background.size() != image_.size()) return false;
    background_.load(background);
    frame_.load(background);
    std::fill(bandLight_.begin(), bandLight_.end(), BandLight::None);
    std::fill(lastWhole_.begin(), lastWhole_.end(), std::uint8_t{0});
    lastRepeats_ = false;
    wholeChanged_ = true;
    return true;
}

void StandardSurface::beginFrame() {
    changed_.clear();
    passes_ = 0;
}

// Units are painted in the order of their numbers. A call out of that order first paints what was noted.
void StandardSurface::noteUnit(std::int32_t unit, std::uint8_t alpha) {
    if (unit <= lastUnit_) paintNoted();
    lastUnit_ = unit;
    alpha_[static_cast<std::size_t>(unit)] = alpha;
}

void StandardSurface::noteWhole(std::int32_t unit) {
    const PlanUnit& planned = plan_.Units[static_cast<std::size_t>(unit)];
    whole_[static_cast<std::size_t>(unit)] = alpha_[static_cast<std::size_t>(unit)];
    notedWhole_.push_back(unit);
    litBulbs_ += planned.ItemCount;
    litPixels_ += std::int64_t{planned.ItemCount} * planned.Side * planned.Side;
}

void StandardSurface::listBulb(std::int32_t unit, std::int32_t bulb0) {
    const PlanUnit& planned = plan_.Units[static_cast<std::size_t>(unit)];
    if (bulb0 < 0 || bulb0 >= planned.BulbCount) return;
    const ZephBulbLocation& bulb = scene_->Tables.BulbPool[static_cast<std::size_t>(planned.FirstBulb + bulb0)];
    const std::int64_t x = std::int64_t{bulb.X} - planned.Side / 2;
    const std::int64_t y = std::int64_t{bulb.Y} - planned.Side / 2;
    if (bulb.Type == kPointPlaceHolder || !touchesCanvas(x, y, planned.Side, plan_.Width, plan_.Height)) return;

    if (listed_.size() == listed_.capacity()) noteUnit(unit, alpha_[static_cast<std::size_t>(unit)]);
    const std::int32_t sprite =
        plan_.SpriteOf[static_cast<std::size_t>(planned.FirstSprite + bulb0 % planned.SpriteCount)];
    listed_.push_back({{static_cast<std::int16_t>(x), static_cast<std::int16_t>(y)}, unit, sprite});
    ++litBulbs_;
    litPixels_ += std::int64_t{planned.Side} * planned.Side;
}

void StandardSurface::drawChannel(const ChannelDraw& draw) {
    if (!scene_ || draw.Alpha == 0 || !OneBased<ZephFixture, kMaxFixtures>::contains(draw.Fixture) ||
        draw.Channel < 1 || draw.Channel > kMaxChannels) {
        return;
    }
    const std::int32_t unit = plan_.NumberOf.OfChannel[channelSlot(draw.Fixture, draw.Channel)];
    const PlanUnit& planned = plan_.Units[static_cast<std::size_t>(unit)];
    if (planned.SpriteCount == 0) return;
    noteUnit(unit, draw.Alpha);
    if (draw.BulbLit == nullptr) {
        noteWhole(unit);
        return;
    }
    for (std::int32_t b = 0; b < planned.BulbCount; ++b) {
        if (draw.BulbLit[b] != 0) listBulb(unit, b);
    }
}

void StandardSurface::drawGroup(const GroupDraw& draw, ZephRGBData& group) {
    if (!scene_ || draw.Alpha == 0 || draw.RGBIndex < 1 ||
        static_cast<std::size_t>(draw.RGBIndex) >= plan_.NumberOf.OfGroup.size()) {
        return;
    }
    const std::int32_t unit = plan_.NumberOf.OfGroup[static_cast<std::size_t>(draw.RGBIndex)];
    const PlanUnit& planned = plan_.Units[static_cast<std::size_t>(unit)];
    if (planned.SpriteCount == 0 || (draw.Bulbs != nullptr && draw.BulbCount == 0)) return;

    noteUnit(unit, draw.Alpha);
    const bool rebuild = RGBBulbRebuildNeeded(group);
    if (rebuild || group.Bulb == 0) updateSprite(unit, draw.Color, group);
    if (draw.Bulbs != nullptr) {
        for (std::int32_t i = 0; i < draw.BulbCount; ++i)
            listBulb(unit, draw.Bulbs[i] - 1);
    } else if (planned.ItemCount > 0) {
        noteWhole(unit);
    } else {
        for (std::int32_t b = 0; b < planned.BulbCount; ++b)
            listBulb(unit, b);
    }
}

void StandardSurface::updateSprite(std::int32_t unit, std::int32_t color, ZephRGBData& group) {
    const PlanUnit& planned = plan_.Units[static_cast<std::size_t>(unit)];
    ZephUpdateRGBChannelBulb(scene_->Document.Fixtures[planned.Fixture], color, scene_->Masks, cache_, pool_, group);
    const std::int32_t number = plan_.SpriteOf[static_cast<std::size_t>(planned.FirstSprite)];
    BulbSprite& present = plan_.Sprites[static_cast<std::size_t>(number)];
    const BulbSprite sprite = spriteOf(pool_.image(group.Bulb));
    if (sprite.Color != present.Color) {
        spriteChanged_[static_cast<std::size_t>(unit)] = 1;
        anySpriteChanged_ = true;
    }
    present = sprite;
}
