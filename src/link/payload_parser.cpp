#include "link/payload_parser.h"

#include "link/command_batch.h"
#include "link/stream_format.h"
#include "link/stream_numbers.h"

#include <algorithm>

namespace {

// What is to happen behind a payload.
enum class Next {
    Payload,    // go on behind it
    DropFrame,  // it cannot be read: the rest of the frame is lost
    Stay,       // not understood: the text is not advanced, so every payload still counted meets it again
};

// The characters of a payload at a column counted from 1; fewer or none where the text ends before.
std::string_view columns(std::string_view text, std::int32_t column, std::int32_t width) {
    const std::size_t start = std::min(text.size(), static_cast<std::size_t>(column - 1));
    return text.substr(start, static_cast<std::size_t>(width));
}

// Reads the fields of one frame's payloads, one by one. Whatever the fast form refuses comes here.
class PayloadReader {
public:
    PayloadReader(const ZephPacketParms& parms, const CommandSink& sink, CommandBatch& batch, ChannelStream& stream)
        : parms_(parms), sink_(sink), batch_(batch), stream_(stream) {}

    // Reads the payload at the front of rest and cuts it off. left: payloads still counted, this one included.
    Next read(std::int32_t left, std::string_view& rest) {
        if (rest.size() < kPayloadHeadChars) return Next::DropFrame;
        const std::optional<std::int32_t> cmd = readDigits(rest.substr(0, 2));
        const std::optional<std::int32_t> sub = readDigits(rest.substr(2, 2));
        if (!cmd || !sub) return Next::DropFrame;
        switch (*cmd) {
        case kCmdLight:
            return lightCommand(*sub, left, rest);
        case kCmdDump:
            return dump(rest);
        case kCmdNoOperation:
            rest.remove_prefix(kPayloadHeadChars);
            return Next::Payload;
        default:
            // An unknown payload type has no length that we know, so nothing behind it can be found.
            return Next::Stay;
        }
    }

private:
    struct Address {
        std::int32_t network;
        std::int32_t deviceType;
        std::int32_t unit;
        std::int32_t circuit;
    };

    static std::optional<Address> readAddress(std::string_view rest) {
        if (rest.size() < kAddressedChars) return std::nullopt;
        const std::optional<std::int32_t> network = readDigits(rest.substr(4, 3));
        const std::optional<std::int32_t> deviceType = readDigits(rest.substr(7, 2));
        const std::optional<std::int32_t> unit = readDigits(rest.substr(9, 3));
        const std::optional<std::int32_t> circuit = readDigits(rest.substr(12, 3));
        if (!network || !deviceType || !unit || !circuit) return std::nullopt;
        return Address{*network, *deviceType, *unit, *circuit};
    }

    Next lightCommand(std::int32_t sub, std::int32_t left, std::string_view& rest) {
        const std::optional<Address> address = readAddress(rest);
        if (!address) return Next::DropFrame;
        const bool subKnown = sub <= 3;
        const PacketParm& parm = parms_[packetIndex(kCmdLight, subKnown ? sub : 0)];
        std::size_t length = static_cast<std::size_t>(parm.TotalFixedLength);
        ZephLightCommand command{kCmdLight,           sub,           address->network,
                                 address->deviceType, address->unit, address->circuit};
        if (command.Network == 0 && command.DeviceType == 0 && command.Unit == 0) {
            const std::size_t keyLength = static_cast<std::size_t>(address->circuit);
            if (rest.size() <= length || rest.size() < length + keyLength) return Next::DropFrame;
            command.Circuit = sink_.virtualChannelKey(rest.substr(length, keyLength));
            length += keyLength;
            if (command.Circuit == 0) {
                rest.remove_prefix(length);
                return Next::Payload;
            }
        }
        if (!subKnown) return unknownSub(command, left);
        if (rest.size() < length) return Next::DropFrame;
        const std::optional<std::int32_t> duration =
            readDurationMs(columns(rest, parm.DurationColumn, parm.DurationWidth));
        const std::optional<std::int32_t> start =
            readDigits(columns(rest, parm.StartLevelColumn, parm.StartLevelWidth));
        const std::optional<std::int32_t> end = readDigits(columns(rest, parm.EndLevelColumn, parm.EndLevelWidth));
        if (!duration || !start || !end) return Next::DropFrame;
        const bool scale255 = sub == 3;
        stream_.LastTiming = {*duration, intensityOf(*start, scale255), intensityOf(*end, scale255)};
        batch_.add({command, stream_.LastTiming});
        rest.remove_prefix(length);
        return Next::Payload;
    }

    // A subtype of a later sender: its timing cannot be read, so the channel is driven with the timing of the payload
    // before, once for every payload that the frame still counts. Displays in the field have been tuned to that.
    Next unknownSub(const ZephLightCommand& command, std::int32_t left) {
        for (std::int32_t i = 0; i < left; ++i)
            batch_.add({command, stream_.LastTiming});
        return Next::Stay;
    }

    Next dump(std::string_view& rest) {
        const std::optional<Address> address = readAddress(rest);
        if (!address) return Next::DropFrame;
        // A count above what arrived: the levels that did arrive are good.
        const std::size_t declared = 2 * static_cast<std::size_t>(address->circuit);
        const std::size_t arrived = (rest.size() - kAddressedChars) / 2 * 2;
        const std::string_view levels = rest.substr(kAddressedChars, std::min(declared, arrived));
        if (!storeDump(*address, levels)) return Next::DropFrame;
        rest.remove_prefix(std::min(rest.size(), kAddressedChars + declared));
        return Next::Payload;
    }

    // A dump for an address that no display can have is passed over; so is one for another device type.
    bool storeDump(const Address& address, std::string_view levels) {
        LevelDumps& dumps = stream_.Dumps;
        if (address.deviceType == kDumpDmx && address.network >= kFirstUniverse && address.network <= kLastUniverse) {
            if (!dumps.ZephDmxDumpTable.store(address.network, levels)) return false;
            dumps.ZephDmxDumpPending = true;
        } else if (address.deviceType == kDumpController && address.network >= kFirstNetwork &&
                   address.network <= kLastNetwork && address.unit >= kFirstUnit && address.unit <= kLastUnit) {
            if (!dumps.ZephControllerDumpTable.store(controllerSlot(address.network, address.unit), levels)) {
                return false;
            }
            dumps.ZephControllerDumpPending = true;
        }
        return true;
    }

    const ZephPacketParms& parms_;
    const CommandSink& sink_;
    CommandBatch& batch_;
    ChannelStream& stream_;
};

// Applies the payloads of a frame's body (the text between SOH and EOT). Returns false where the frame, or the rest of
// it, had to be dropped; the payloads before stay applied.
bool applyFrame(std::string_view body, const ParserSetup& setup, bool fast, CommandSink& sink, ChannelStream& stream) {
    if (body.size() < kHeaderChars) return false;
    const std::optional<std::int32_t> count = readDigits(body.substr(0, 3));
    const std::optional<std::int32_t> length = readDigits(body.substr(3, 4));
    if (!count || !length || static_cast<std::size_t>(*length) != body.size()) return false;

    std::string_view rest = body.substr(kHeaderChars);
    CommandBatch batch(sink);
    PayloadReader reader(setup.PacketParms, sink, batch, stream);
    std::int32_t left = *count;
    Next next = Next::Payload;
    while (left > 0 && next == Next::Payload) {
        if (fast) {
            const std::size_t most = std::min(batch.room(), static_cast<std::size_t>(left));
            const std::size_t run = setup.decodeRun(rest, most, batch.free());
            if (run > 0) {
                stream.LastTiming = batch.free()[run - 1].Timing;
                stream.ZephPayloadSerial += static_cast<std::uint32_t>(run);
                left -= static_cast<std::int32_t>(run);
                rest.remove_prefix(run * static_cast<std::size_t>(kLightCommandParm.TotalFixedLength));
                batch.take(run);
            }
            if (run == most) continue;
        }
        next = reader.read(left, rest);
        stream.ZephPayloadSerial += static_cast<std::uint32_t>(next == Next::Stay ? left : 1);
        --left;
    }
    batch.flush();
    return next != Next::DropFrame;
}

}  // namespace

void ZephProcessPayloads(bool simulating, const ParserSetup& setup, CommandSink& sink, FailureReport& failures,
                         ChannelStream& stream) try {
    StreamBuffer& buffer = stream.ZephStackBuffer;
    if (!simulating) buffer.clear();
    const bool fast = hasStandardLayout(setup.PacketParms);
    bool wellFormed = true;
    while (wellFormed && !buffer.empty() && buffer.resynchronise()) {
        const std::size_t end = buffer.findEndOfFrame();
        if (end == StreamBuffer::kNone) return;
        const std::string_view body = buffer.view().substr(1, end - 1);
        buffer.consume(end + 1);  // whatever becomes of the frame, it is out of the buffer
        try {
            wellFormed = applyFrame(body, setup, fast, sink, stream);
        } catch (...) {
            // A bad frame is never reported: a display must not be stopped by what a sender writes.
            wellFormed = false;
        }
    }
}
ZEPH_GUARD(failures, "modZephCommunications", )
