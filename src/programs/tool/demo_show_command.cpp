#include "programs/tool/demo_show_command.h"

#include "programs/tool/demo_show.h"
#include "programs/tool/tool_document.h"

#include <algorithm>

int runDemoShow(const ToolOptions& options) {
    const CompiledDocument display = compileToolDocument(options.file);
    if (!display.ok()) return 1;
    const ShowCast cast = gatherShowCast(*display.document->simulation, display.tables, *display.states);
    for (const std::int32_t key : cast.unreachable) {
        std::fprintf(stderr, "zeph-tool: no command can address the channel key %d\n", key);
    }
    const std::int32_t seconds = std::min(options.seconds.value_or(kDefaultShowMs / 1000), kLongestShowMs / 1000);
    CaptureWriter writer(options.out);
    for (const CapturePiece& piece : ZephMakeDemoShow(cast, seconds * 1000))
        writer.piece(piece.timeMs, piece.bytes);
    return 0;
}
