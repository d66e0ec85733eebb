#include "engine/opengl_surface.h"

#include "util/rounding.h"

#include <algorithm>

namespace {

constexpr const char* kModule = "modZephRenderOPenGL";
constexpr std::size_t kLeastListed = 1024;

// Ranges with no more than this between them are drawn as one: dark bulbs cost the GPU less than another call does the
// driver. In indices, about 32 small bulbs.
constexpr std::int32_t kBridgedIndices = 600;

template <typename T>
void dropStorage(std::vector<T>& list) {
    std::vector<T>().swap(list);
}

}  // namespace

bool OpenGLSurface::ZephGLStartup(const GLScene& scene, GLTarget& target, FailureReport& failures) try {
    release();
    require(scene.Width >= 1 && scene.Height >= 1 && scene.Width <= kMaxCanvasPixels &&
                scene.Height <= kMaxCanvasPixels,
            "The canvas is empty or too large");
    require(target.makeCurrent(), "The OpenGL context cannot be used");
    const GLApi api = loadGLApi([&](const char* name) { return target.resolve(name); });
    plan_ = makeGLPlan(scene.Document, scene.Tables, scene.States, scene.Shapes);

    const std::size_t listed = std::max(kLeastListed, 2 * static_cast<std::size_t>(plan_.ListedBulbs));
    const QSize size(scene.Width, scene.Height);
    const bool fits = scene.Picture.isNull() || scene.Picture.size() == size;
    canvas_.create(api, plan_,
                   fits ? scene.Picture : scene.Picture.scaled(size, Qt::IgnoreAspectRatio, Qt::SmoothTransformation),
                   {static_cast<double>(scene.Width), static_cast<double>(scene.Height), scene.Intensity / 100.0},
                   static_cast<std::int32_t>(listed));
    dropStorage(plan_.Vertices);
    dropStorage(plan_.Indices);
    dropStorage(plan_.Corners);
    dropStorage(plan_.CornerIndices);

    const std::size_t units = plan_.Units.size();
    work_.SlotColors.assign(plan_.SlotColors.size(), 0);
    work_.RangeCounts.reserve(units);
    work_.RangeOffsets.reserve(units);
    work_.Instances.reserve(listed);
    work_.Batches.reserve(units + listed);
    mostListed_ = listed;
    target_ = &target;
    failures_ = &failures;
    document_ = &scene.Document;
    tables_ = &scene.Tables;
    curve_ = &scene.Curve;
    return true;
} catch (...) {
    release();
    reportCaughtFailure(failures, kModule, __func__, 0);
    return false;
}

void OpenGLSurface::release() {
    if (target_ != nullptr && target_->makeCurrent()) canvas_.destroy();
    canvas_.forget();
    document_ = nullptr;
    tables_ = nullptr;
    curve_ = nullptr;
    target_ = nullptr;
    failures_ = nullptr;
    plan_ = {};
    work_ = {};
    current_ = lostTold_ = false;
}

void OpenGLSurface::setViewport(std::int32_t width, std::int32_t height, double pixelRatio) {
    if (document_ != nullptr && target_->makeCurrent()) canvas_.setViewport(width, height, pixelRatio);
}

void OpenGLSurface::beginFrame() {
    if (document_ == nullptr) return;
    forgetNoted();
    begun_ = false;
    const bool seen = target_->isSeen();
    current_ = seen && target_->makeCurrent();
    if (!seen || current_ || lostTold_) return;
    lostTold_ = true;  // it would be told in every frame
    failures_->ErrReport("The OpenGL context was lost", procedureName(kModule, "ZephGLBeginFrame"), 0);
}

void OpenGLSurface::drawChannel(const ChannelDraw& draw) {
    if (!current_ || draw.Alpha == 0 || !OneBased<ZephFixture, kMaxFixtures>::contains(draw.Fixture) ||
        draw.Channel < 1 || draw.Channel > kMaxChannels) {
        return;
    }
    const ZephFixture& fixture = document_->Fixtures[draw.Fixture];
    std::uint32_t alpha = draw.Alpha;
    // An opacity of 0..255 is compared with a percentage: flood opacities in displays were set by eye against exactly
    // this.
    if (fixture.Fixture_Type == kFixtureFlood && draw.Alpha > fixture.Max_Opacity) {
        alpha = (*curve_)[static_cast<std::size_t>(levelCut(std::clamp(fixture.Max_Opacity, 0, 100)))];
    }
    if (alpha != 0)
        lightUnit(plan_.NumberOf.OfChannel[channelSlot(draw.Fixture, draw.Channel)], draw.BulbLit, alpha << 24);
}

void OpenGLSurface::drawGroup(const GroupDraw& draw, ZephRGBData&) {
    if (!current_ || draw.Alpha == 0 || draw.RGBIndex < 1 ||
        static_cast<std::size_t>(draw.RGBIndex) >= plan_.NumberOf.OfGroup.size()) {
        return;
    }
    const std::int32_t number = plan_.NumberOf.OfGroup[static_cast<std::size_t>(draw.RGBIndex)];
    const std::uint32_t color =
        (static_cast<std::uint32_t>(draw.Color) & static_cast<std::uint32_t>(kWhite)) | std::uint32_t{draw.Alpha} << 24;
    if (draw.Bulbs == nullptr) {
        lightUnit(number, nullptr, color);
        return;
    }
    for (std::int32_t i = 0; i < draw.BulbCount; ++i)
        listBulb(plan_.Units[static_cast<std::size_t>(number)], draw.Bulbs[i] - 1, color);
}

// color is laid over that of each slot: the alpha alone for a channel, everything for a group.
void OpenGLSurface::lightUnit(std::int32_t number, const std::uint8_t* bulbLit, std::uint32_t color) {
    const GLPlanUnit& unit = plan_.Units[static_cast<std::size_t>(number)];
    if (unit.Shape < 0) return;
    const bool slotEach = unit.SlotCount == unit.BulbCount;
    if (unit.SlotCount == 0 || (bulbLit != nullptr && !slotEach)) {
        for (std::int32_t b = 0; b < unit.BulbCount; ++b) {
            if (bulbLit != nullptr && bulbLit[b] == 0) continue;
            const std::int32_t slot = unit.SlotCount == 0 ? -1 : unit.FirstSlot + b % unit.SlotCount;
            listBulb(unit, b, color | (slot < 0 ? 0 : plan_.SlotColors[static_cast<std::size_t>(slot)]));
        }
        return;
    }
    if (unit.IndexCount == 0) return;
    noteRange(number, unit);
    for (std::int32_t s = 0; s < unit.SlotCount; ++s) {
        if (bulbLit != nullptr && bulbLit[s] == 0) continue;
        const auto slot = static_cast<std::size_t>(unit.FirstSlot + s);
        work_.SlotColors[slot] = plan_.SlotColors[slot] | color;
    }
}

void OpenGLSurface::noteRange(std::int32_t number, const GLPlanUnit& unit) {
    // Slots are looked up when all is painted: a unit out of order would light up where it was bridged as dark, or give
    // its slots a second colour.
    if (number <= lastUnit_) submit();
    lastUnit_ = number;
    handedOver_ = false;

    const bool first = work_.FirstSlot == work_.EndSlot;
    work_.FirstSlot = first ? unit.FirstSlot : std::min(work_.FirstSlot, unit.FirstSlot);
    work_.EndSlot = std::max(work_.EndSlot, unit.FirstSlot + unit.SlotCount);

    const bool afterRange = !work_.Batches.empty() && work_.Batches.back().Shape < 0;
    if (afterRange && unit.FirstIndex - rangeEnd_ <= kBridgedIndices) {
        work_.RangeCounts.back() += unit.FirstIndex + unit.IndexCount - rangeEnd_;
    } else {
        if (!afterRange) work_.Batches.push_back({-1, static_cast<std::int32_t>(work_.RangeCounts.size()), 0});
        ++work_.Batches.back().Count;
        work_.RangeCounts.push_back(unit.IndexCount);
        work_.RangeOffsets.push_back(
            reinterpret_cast<const void*>(static_cast<std::uintptr_t>(unit.FirstIndex) * sizeof(std::uint32_t)));
    }
    rangeEnd_ = unit.FirstIndex + unit.IndexCount;
}

void OpenGLSurface::listBulb(const GLPlanUnit& unit, std::int32_t bulb0, std::uint32_t color) {
    if (unit.Shape < 0 || bulb0 < 0 || bulb0 >= unit.BulbCount) return;
    const ZephBulbLocation& bulb = tables_->BulbPool[static_cast<std::size_t>(unit.FirstBulb + bulb0)];
    if (!drawnBulb(bulb)) return;
    if (work_.Instances.size() == mostListed_) submit();
    handedOver_ = false;
    if (work_.Batches.empty() || work_.Batches.back().Shape != unit.Shape) {
        work_.Batches.push_back({unit.Shape, static_cast<std::int32_t>(work_.Instances.size()), 0});
    }
    ++work_.Batches.back().Count;
    work_.Instances.push_back({static_cast<std::int16_t>(bulb.X), static_cast<std::int16_t>(bulb.Y), color});
}

void OpenGLSurface::handOver() {
    if (!handedOver_ && current_) canvas_.upload(work_);
    handedOver_ = true;
}

// Paints what was noted since the frame began, or since the pass before.
void OpenGLSurface::submit() {
    handOver();
    if (!begun_) canvas_.ZephGLBeginFrame();
    begun_ = true;
    canvas_.draw(work_);
    forgetNoted();
}

void OpenGLSurface::forgetNoted() {
    std::fill(work_.SlotColors.begin() + work_.FirstSlot, work_.SlotColors.begin() + work_.EndSlot, 0U);
    work_.FirstSlot = work_.EndSlot = 0;
    work_.RangeCounts.clear();
    work_.RangeOffsets.clear();
    work_.Instances.clear();
    work_.Batches.clear();
    handedOver_ = false;
    lastUnit_ = 0;
}

void OpenGLSurface::endFrame() {
    if (!current_) return;
    submit();
    target_->swapBuffers();
    current_ = false;
}
