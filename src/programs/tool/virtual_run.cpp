#include "programs/tool/virtual_run.h"

VirtualRun::VirtualRun(CompiledDocument& display, Capture capture, const std::string& engine, std::uint64_t seed)
    : display_(display), capture_(std::move(capture)), engine_(engine == "opengl" ? kEngineOpenGL : kEngineStandard),
      random_(seed),
      // Always the identity: a picture must not depend on a curve that happens to lie in somebody's folder.
      curve_(ZephCreateDummyDimmingCurve()) {}

void VirtualRun::run(std::int32_t until, LightSurface& surface, const std::function<bool(std::int32_t)>& onFrame) {
    ManualClock clock(kVirtualStartMs);
    ZephRenderClocks clocks = clocksAtEntry(kVirtualStartMs);
    ParserSetup parser;
    ZephSetUpPacketParms(parser.PacketParms);
    RenderTableSink sink(display_.tables, clock);
    ChannelStream stream;
    ToolDocument& document = *display_.document;
    RenderContext context{*document.simulation, curve_, display_.tables, *display_.states, clocks, random_, surface,
                          document.failures};
    bool drawn = false;
    const std::function<void()> frameDone = [&] { drawn = true; };
    const TickContext tick{clock, parser, document.host, sink, stream, context, frameDone};

    std::size_t next = 0;
    for (std::int32_t t = tickMs(); t <= until; t += tickMs()) {
        for (; next < capture_.pieces.size() && capture_.pieces[next].timeMs <= t; ++next) {
            stream.ZephStackBuffer.append(capture_.pieces[next].bytes);
        }
        clock.set(kVirtualStartMs + t);
        drawn = false;
        ZephRenderTick(engine_, tick);
        if (drawn && !onFrame(t)) return;
    }
}
