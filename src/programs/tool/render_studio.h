// Where the headless companion draws: a surface of one of the two engines, and the picture on it.
#pragma once

#include "engine/light_surface.h"
#include "model/dimming_curve.h"
#include "programs/tool/tool_document.h"

#include <QImage>

#include <memory>
#include <string>

class RenderStudio {
public:
    virtual ~RenderStudio() = default;
    virtual LightSurface& surface() = 0;
    virtual QSize size() const = 0;  // pixels
    // Whether the next frame is asked for by picture(): one that is not may be left out where frames stand alone.
    virtual void expectPicture(bool wanted) = 0;
    virtual QImage picture() = 0;  // the last frame; valid until the next one
};

// Ready to draw the display on the background of its document. engine: "standard" or "opengl". nullptr where it cannot
// be drawn; that was told. Throws Failure where there is no OpenGL. Display and curve must outlive the studio.
std::unique_ptr<RenderStudio> openRenderStudio(const std::string& engine, CompiledDocument& display,
                                               const ZephDimmingCurve& curve);
