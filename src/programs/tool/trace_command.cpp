#include "programs/tool/trace_command.h"

#include "programs/tool/virtual_run.h"

#include <cstdio>

namespace {

// Writes each call as text of its own frame; the frame is printed when it ends.
class TraceSurface : public LightSurface {
public:
    explicit TraceSurface(bool json) : json_(json) {}

    void beginFrame() override { draws_.clear(); }
    void endFrame() override {}

    void drawChannel(const ChannelDraw& draw) override {
        add(json_ ? R"({"Level":%d,"Fixture":%d,"Channel":%d,"I":%d})" : " L%d F%d C%d I%d", draw.Level, draw.Fixture,
            draw.Channel, draw.Intensity);
    }

    void drawGroup(const GroupDraw& draw, ZephRGBData& group) override {
        add(json_ ? R"({"Level":%d,"Fixture":%d,"RGBIndex":%d,"Triplet":%d,"RGB":[%d,%d,%d]})"
                  : " L%d F%d G%d T%d RGB %d/%d/%d",
            draw.Level, draw.Fixture, draw.RGBIndex, draw.Triplet, group.Level[1], group.Level[2], group.Level[3]);
    }

    void print(std::int32_t t) const {
        std::printf(json_ ? R"({"t":%d,"Draws":[%s]})"
                            "\n"
                          : "%d%s\n",
                    t, draws_.c_str());
    }

private:
    template <typename... Values>
    void add(const char* format, Values... values) {
        char text[160];
        const int length = std::snprintf(text, sizeof text, format, values...);
        if (json_ && !draws_.empty()) draws_ += ',';
        draws_.append(text, static_cast<std::size_t>(length));
    }

    bool json_;
    std::string draws_;
};

}  // namespace

int runTrace(const ToolOptions& options) {
    CompiledDocument display = compileToolDocument(options.file);
    if (!display.ok()) return 1;
    VirtualRun run(display, loadCapture(options.capture), options.engine, options.seed);
    TraceSurface surface(options.json);
    run.run(*options.until, surface, [&](std::int32_t t) {
        surface.print(t);
        return true;
    });
    return 0;
}
