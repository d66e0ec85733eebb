// Any bytes as a channel stream: every form of the parser must do what the plain one does, however the bytes are cut
// into pieces. The first byte says where they are cut.
#include "link/payload_parser.h"
#include "tests/support/plain_parser.h"
#include "tests/support/recording_host.h"
#include "tests/support/recording_sink.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdlib>
#include <vector>

namespace {

void check(bool same) {
    if (!same) std::abort();
}

template <typename Levels>
bool sameLevels(const Levels& stored, const std::string& levels) {
    return std::string(stored.begin(), stored.end()) == levels;
}

// Kept between the runs, since making its dump tables takes longer than a run.
ChannelStream stream;

void forget() {
    stream.ZephStackBuffer.clear();
    stream.LastTiming = {};
    stream.ZephPayloadSerial = 0;
    clearLevelDumps(stream.Dumps);
}

void compare(DecodeForm form, std::string_view first, std::string_view second) {
    CollectingFailures failures;
    ParserSetup setup{.decodeRun = decodeRunOf(form)};
    ZephSetUpPacketParms(setup.PacketParms);
    forget();
    PlainParser plain;
    RecordingSink sink;
    RecordingSink plainSink;
    sink.channels = plainSink.channels = {{"arch_1", 1}, {"a", 2}, {"", 3}};
    // The third call works off what a bad frame left.
    for (const std::string_view piece : {first, second, std::string_view()}) {
        stream.ZephStackBuffer.append(piece);
        plain.buffer += piece;
        ZephProcessPayloads(true, setup, sink, failures, stream);
        plain.process(plainSink);
        check(stream.ZephStackBuffer.view() == plain.buffer);
    }
    check(sink.commands == plainSink.commands);
    check(stream.ZephPayloadSerial == plain.serial);
    check(stream.LastTiming == plain.timing);
    check(stream.Dumps.ZephDmxDumpPending == plain.dmxPending);
    check(stream.Dumps.ZephControllerDumpPending == plain.controllerPending);
    for (const auto& [universe, levels] : plain.dmxDumps)
        check(sameLevels(stream.Dumps.ZephDmxDumpTable.levels(universe), levels));
    for (const auto& [address, levels] : plain.controllerDumps) {
        check(sameLevels(stream.Dumps.ZephControllerDumpTable.levels(controllerSlot(address.first, address.second)),
                         levels));
    }
    check(failures.reports.empty());
}

// The receive buffer has room behind its last byte; a block of exactly the text's size shows a read past the end.
void decodeAtTheEdge(DecodeForm form, std::string_view text) {
    const std::vector<char> exact(text.begin(), text.end());
    std::array<ZephChannelCommand, 64> commands;
    decodeRunOf(form)({exact.data(), exact.size()}, commands.size(), commands.data());
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    if (size == 0) return 0;
    const std::string_view text(reinterpret_cast<const char*>(data) + 1, size - 1);
    const std::size_t cut = text.size() * data[0] / 256;
    for (const DecodeForm form : {DecodeForm::Plain, DecodeForm::Sse41}) {
        if (!hasDecodeForm(form)) continue;
        compare(form, text.substr(0, cut), text.substr(cut));
        decodeAtTheEdge(form, text.substr(std::min(text.size(), std::size_t{8})));  // behind SOH and header
    }
    return 0;
}
