#include "engine/standard_surface.h"

#include <algorithm>

namespace {

constexpr std::size_t kLeastListed = 1024;

void loadPicture(const QImage& picture, PixelStore& store) {
    const QImage opaque = picture.convertToFormat(QImage::Format_RGB32);
    for (std::int32_t y = 0; y < opaque.height(); ++y) {
        const auto* from = reinterpret_cast<const std::uint32_t*>(opaque.constScanLine(y));
        std::transform(from, from + opaque.width(), store.row(y), [](std::uint32_t p) { return p | 0xFF000000U; });
    }
}

}  // namespace

void PixelStore::resize(std::int32_t width, std::int32_t height) {
    stride_ = wholeCacheLines(width + kBlendOverreach);
    pixels_.assign(static_cast<std::size_t>(stride_) * static_cast<std::size_t>(height) + kCacheLinePixels,
                   0xFF000000U);
    const auto address = reinterpret_cast<std::uintptr_t>(pixels_.data());
    constexpr std::uintptr_t kLineBytes = kCacheLinePixels * sizeof(std::uint32_t);
    first_ = pixels_.data() + (kLineBytes - address % kLineBytes) % kLineBytes / sizeof(std::uint32_t);
}

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
    pool_.reserve(plan_.Groups, plan_.FloodGroups, plan_.MaxFloodSize);
    frame_.resize(width, height);
    background_.resize(width, height);
    band_.resize(kBandMargin + wholeCacheLines(width) + kBandMargin, kBandRows + 2 * kBandMarginRows);
    image_ = QImage(reinterpret_cast<uchar*>(frame_.row(0)), width, height,
                    frame_.stride() * static_cast<qsizetype>(sizeof(std::uint32_t)), QImage::Format_RGB32);

    const auto bands = static_cast<std::size_t>(plan_.BandCount);
    const std::size_t listed = std::max(kLeastListed, 2 * static_cast<std::size_t>(plan_.ListedBulbs));
    alpha_.assign(plan_.Units.size(), 0);
    lastAlpha_ = alpha_;
    spriteChanged_ = alpha_;
    noted_.reserve(plan_.Units.size() + 1);
    listed_.reserve(listed);
    bandListed_.resize(listed_.capacity() * static_cast<std::size_t>(plan_.MaxSide / kBandRows + 2));
    firstBandListed_.resize(bands + 1);
    lit_.reserve(plan_.Places.size() + listed);
    litUnits_.reserve(plan_.Units.size());
    tiles_.assign(kMaxTileRows, 0);
    changed_.reserve(1 + bands + kMaxTileRows * kMaxTileRows);
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
    band_ = {};
    noted_.clear();
    listed_.clear();
    lit_.clear();
    litUnits_.clear();
    changed_.clear();
    lastRepeats_ = false;
}

bool StandardSurface::setBackground(const QImage& background) {
    if (!scene_ || background.size() != image_.size()) return false;
    loadPicture(background, background_);
    loadPicture(background, frame_);
    lit_.clear();
    litUnits_.clear();
    std::fill(bandLight_.begin(), bandLight_.end(), BandLight::None);
    std::fill(lastAlpha_.begin(), lastAlpha_.end(), std::uint8_t{0});
    lastRepeats_ = false;
    wholeChanged_ = true;
    return true;
}

void StandardSurface::beginFrame() {
    changed_.clear();
    passes_ = 0;
}

// Units are painted in the order of their numbers. A call out of that order first paints what was noted.
void StandardSurface::noteUnit(std::int32_t unit) {
    if (!noted_.empty() && noted_.back().Unit >= unit) paintNoted();
    noted_.push_back({unit, -1, 0});
}

void StandardSurface::noteRuns(std::int32_t unit, std::uint8_t alpha) {
    alpha_[static_cast<std::size_t>(unit)] = alpha;
    const PlanUnit& planned = plan_.Units[static_cast<std::size_t>(unit)];
    litBulbs_ += planned.VisibleBulbs;
    litPixels_ += std::int64_t{planned.VisibleBulbs} * planned.Side * planned.Side;
}

void StandardSurface::listBulb(std::int32_t unit, std::int32_t bulb0, std::uint8_t alpha) {
    const PlanUnit& planned = plan_.Units[static_cast<std::size_t>(unit)];
    if (bulb0 < 0 || bulb0 >= planned.BulbCount) return;
    const ZephBulbLocation& bulb = scene_->Tables.BulbPool[static_cast<std::size_t>(planned.FirstBulb + bulb0)];
    const std::int64_t x = std::int64_t{bulb.X} - planned.Side / 2;
    const std::int64_t y = std::int64_t{bulb.Y} - planned.Side / 2;
    if (bulb.Type == kPointPlaceHolder || !touchesCanvas(x, y, planned.Side, plan_.Width, plan_.Height)) return;

    if (listed_.size() == listed_.capacity()) {
        paintNoted();
        noteUnit(unit);
    }
    NotedUnit& noted = noted_.back();
    if (noted.FirstListed < 0) noted.FirstListed = static_cast<std::int32_t>(listed_.size());
    ++noted.ListedCount;
    listed_.push_back({{static_cast<std::int16_t>(x), static_cast<std::int16_t>(y)},
                       planned.FirstSprite + bulb0 % planned.SpriteCount,
                       unit,
                       alpha});
    ++litBulbs_;
    litPixels_ += std::int64_t{planned.Side} * planned.Side;
}

void StandardSurface::drawChannel(const ChannelDraw& draw) {
    if (!scene_ || draw.Alpha == 0 || !OneBased<ZephFixture, kMaxFixtures>::contains(draw.Fixture) ||
        draw.Channel < 1 || draw.Channel > kMaxChannels) {
        return;
    }
    const std::int32_t unit =
        plan_.UnitOfChannel[static_cast<std::size_t>(draw.Fixture * (kMaxChannels + 1) + draw.Channel)];
    const PlanUnit& planned = plan_.Units[static_cast<std::size_t>(unit)];
    if (planned.SpriteCount == 0) return;
    noteUnit(unit);
    if (draw.BulbLit == nullptr) {
        noteRuns(unit, draw.Alpha);
        return;
    }
    for (std::int32_t b = 0; b < planned.BulbCount; ++b) {
        if (draw.BulbLit[b] != 0) listBulb(unit, b, draw.Alpha);
    }
}

void StandardSurface::drawGroup(const GroupDraw& draw, ZephRGBData& group) {
    if (!scene_ || draw.Alpha == 0 || draw.RGBIndex < 1 ||
        static_cast<std::size_t>(draw.RGBIndex) >= plan_.UnitOfGroup.size()) {
        return;
    }
    const std::int32_t unit = plan_.UnitOfGroup[static_cast<std::size_t>(draw.RGBIndex)];
    const PlanUnit& planned = plan_.Units[static_cast<std::size_t>(unit)];
    if (planned.SpriteCount == 0 || (draw.Bulbs != nullptr && draw.BulbCount == 0)) return;

    noteUnit(unit);
    const bool rebuild = RGBBulbRebuildNeeded(group);
    if (rebuild || group.Bulb == 0) updateSprite(planned, draw.Color, group);
    if (draw.Bulbs != nullptr) {
        for (std::int32_t i = 0; i < draw.BulbCount; ++i)
            listBulb(unit, draw.Bulbs[i] - 1, draw.Alpha);
    } else if (planned.RunCount > 0) {
        noteRuns(unit, draw.Alpha);
    } else {
        for (std::int32_t b = 0; b < planned.BulbCount; ++b)
            listBulb(unit, b, draw.Alpha);
    }
}

void StandardSurface::updateSprite(const PlanUnit& planned, std::int32_t color, ZephRGBData& group) {
    ZephUpdateRGBChannelBulb(scene_->Document.Fixtures[planned.Fixture], color, scene_->Masks, cache_, pool_, group);
    const BulbSprite sprite = spriteOf(pool_.image(group.Bulb));
    BulbSprite& present = plan_.Sprites[static_cast<std::size_t>(planned.FirstSprite)];
    if (sprite.Color != present.Color) {
        spriteChanged_[static_cast<std::size_t>(noted_.back().Unit)] = 1;
        anySpriteChanged_ = true;
    }
    present = sprite;
}
