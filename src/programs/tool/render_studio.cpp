#include "programs/tool/render_studio.h"

#include "editor/background.h"
#include "engine/gl_offscreen.h"
#include "engine/opengl_surface.h"
#include "engine/standard_surface.h"

#include <QCoreApplication>

namespace {

std::string programFolder() {
    return QCoreApplication::applicationDirPath().toStdString();
}

class StandardStudio : public RenderStudio {
public:
    bool prepare(CompiledDocument& display, const ZephDimmingCurve& curve) {
        ToolDocument& document = *display.document;
        ZephSetUpMasks(
            curve, [](std::string_view) {}, *masks_);
        ZephRebuildStaticFixtureBulbs(*document.simulation, *masks_, *bulbs_);
        const QImage background =
            ZephResetBackground(*document.simulation, programFolder(), document.host).picBackground;
        return surface_.prepare({*document.simulation, display.tables, *display.states, *masks_, *bulbs_, background},
                                document.failures);
    }

    LightSurface& surface() override { return surface_; }
    QSize size() const override { return surface_.image().size(); }
    void expectPicture(bool) override {}  // it keeps images of colours from frame to frame
    QImage picture() override { return surface_.image(); }

private:
    std::unique_ptr<ZephMasks> masks_ = std::make_unique<ZephMasks>();
    std::unique_ptr<ZephStaticBulbs> bulbs_ = std::make_unique<ZephStaticBulbs>();
    StandardSurface surface_;
};

class OpenGLStudio : public RenderStudio {
public:
    explicit OpenGLStudio(QSize size) : size_(size), target_(size.width(), size.height()) {}

    bool prepare(CompiledDocument& display, const ZephDimmingCurve& curve) {
        ToolDocument& document = *display.document;
        const auto shapes = std::make_unique<ZephGLShapes>();
        ZephGLCreateShapes(*shapes);
        const bool hasPicture = document.simulation->Background.BackgroundType == kBackgroundPicture;
        const QImage picture =
            hasPicture ? ZephResetBackground(*document.simulation, programFolder(), document.host).Picture3 : QImage();
        return surface_.ZephGLStartup({*document.simulation, display.tables, *display.states, curve, *shapes, picture,
                                       document.simulation->Background.PicIntensity, size_.width(), size_.height()},
                                      target_, document.failures);
    }

    LightSurface& surface() override { return surface_; }
    QSize size() const override { return size_; }
    void expectPicture(bool wanted) override { target_.setSeen(wanted); }
    QImage picture() override { return target_.image(); }

private:
    QSize size_;
    GLOffscreen target_;
    OpenGLSurface surface_;
};

}  // namespace

std::unique_ptr<RenderStudio> openRenderStudio(const std::string& engine, CompiledDocument& display,
                                               const ZephDimmingCurve& curve) {
    const auto ready = [&](auto studio) -> std::unique_ptr<RenderStudio> {
        return studio->prepare(display, curve) ? std::move(studio) : nullptr;
    };
    if (engine != "opengl") return ready(std::make_unique<StandardStudio>());
    return ready(std::make_unique<OpenGLStudio>(canvasSize(display.document->simulation->Background)));
}
