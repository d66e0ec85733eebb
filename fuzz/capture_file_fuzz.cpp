// Any bytes as a capture file: they are read or refused with a line number, and what was read survives being written
// and read again.
#include "link/capture_file.h"
#include "util/failure.h"

#include <cstdint>
#include <cstdlib>
#include <string>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Capture capture;
    try {
        capture = parseCapture({reinterpret_cast<const char*>(data), size});
    } catch (const Failure& failure) {
        if (!std::string_view(failure.what()).starts_with("line ")) std::abort();
        return 0;
    }
    std::string written(kCaptureHeader);
    written += '\n';
    for (const CapturePiece& piece : capture.pieces)
        written += captureLine(piece.timeMs, piece.bytes);
    if (parseCapture(written).pieces != capture.pieces) std::abort();
    return 0;
}
