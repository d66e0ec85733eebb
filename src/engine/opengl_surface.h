// The OpenGL drawing surface: every bulb a flat polygon, blended with its alpha over the background. The calls of a
// frame are noted, and handed over and painted together at its end, in the order of the calls. One thread; a frame
// allocates nothing.
#pragma once

#include "engine/gl_canvas.h"
#include "engine/gl_target.h"
#include "engine/light_surface.h"
#include "model/dimming_curve.h"
#include "util/failure.h"

#include <QImage>

#include <cstdint>
#include <vector>

// What a simulation is drawn from. Document, tables and curve must outlive the surface's use and keep their
// place; states, shapes and picture are not needed after ZephGLStartup.
struct GLScene {
    const ZephSimulation& Document;
    const ZephRenderTables& Tables;
    const ZephFixtureStates& States;
    const ZephDimmingCurve& Curve;
    const ZephGLShapes& Shapes;
    const QImage& Picture;         // at its own brightness, stretched to the drawing; null = white
    std::int32_t Intensity = 100;  // per cent: the picture's opacity over black
    std::int32_t Width = 0;        // pixels, the drawing, 1..2500
    std::int32_t Height = 0;
};

class OpenGLSurface : public LightSurface {
public:
    // At entry into simulation. The target must live until release, or until the next start. False, with a report,
    // where its context cannot draw the scene; the surface then draws nothing.
    [[nodiscard]] bool ZephGLStartup(const GLScene& scene, GLTarget& target, FailureReport& failures);

    // Gives all storage back, on the GPU too; nothing is drawn until the next start. To be called while the target
    // lives.
    void release();

    // The window has another size, in pixels of the canvas, each of which is pixelRatio pixels of the screen.
    void setViewport(std::int32_t width, std::int32_t height, double pixelRatio);

    void beginFrame() override;
    void drawChannel(const ChannelDraw& draw) override;
    void drawGroup(const GroupDraw& draw, ZephRGBData& group) override;
    void endFrame() override;

    // Hands over what has been noted; endFrame does so by itself. For a benchmark, which times it apart from what the
    // driver does after.
    void handOver();

private:
    void lightUnit(std::int32_t number, const std::uint8_t* bulbLit, std::uint32_t color);
    void noteRange(std::int32_t number, const GLPlanUnit& unit);
    void listBulb(const GLPlanUnit& unit, std::int32_t bulb0, std::uint32_t color);
    void submit();
    void forgetNoted();

    const ZephSimulation* document_ = nullptr;  // nullptr = not started
    const ZephRenderTables* tables_ = nullptr;
    const ZephDimmingCurve* curve_ = nullptr;
    GLTarget* target_ = nullptr;
    FailureReport* failures_ = nullptr;
    GLCanvas canvas_;
    GLPlan plan_;  // without what lies on the GPU
    GLWork work_;

    std::size_t mostListed_ = 0;  // bulbs in one upload
    bool current_ = false;        // the frame under way can be drawn
    bool lostTold_ = false;       // a lost context is reported once
    bool begun_ = false;          // the background is painted
    bool handedOver_ = false;     // what is noted lies on the GPU
    std::int32_t lastUnit_ = 0;   // of the ranges noted since the last upload was painted, 0 = none
    std::int32_t rangeEnd_ = 0;   // one past the last index of the last range
};
