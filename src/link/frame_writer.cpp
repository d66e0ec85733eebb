#include "link/frame_writer.h"

#include "link/stream_format.h"
#include "util/failure.h"

namespace {

// Appends the number with leading zeros. It was checked before that it fits.
void appendDigits(std::string& text, std::int32_t number, std::size_t width) {
    const std::size_t start = text.size();
    text.append(width, '0');
    for (std::size_t i = width; i-- > 0; number /= 10)
        text[start + i] = static_cast<char>('0' + number % 10);
}

// Hundredths of a second in eight characters. Receivers count in ms, so one place behind the point is enough; short
// durations are written with three because that is what senders have always written.
void appendDuration(std::string& text, std::int32_t durationMs) {
    constexpr std::int32_t longestWithThreePlaces = 99'999;
    const std::int32_t hundredths = durationMs / 10;
    const std::int32_t tenths = durationMs % 10;
    if (durationMs <= longestWithThreePlaces) {
        appendDigits(text, hundredths, 4);
        text += '.';
        appendDigits(text, tenths * 100, 3);
    } else {
        appendDigits(text, hundredths, 6);
        text += '.';
        appendDigits(text, tenths, 1);
    }
}

bool within(std::int32_t value, std::int32_t low, std::int32_t high) {
    return value >= low && value <= high;
}

}  // namespace

void FrameWriter::command(const ZephLightCommand& address, const ZephLightTiming& timing) {
    require(address.Network != 0 || address.DeviceType != 0 || address.Unit != 0,
            "network, device type and unit all zero address a virtual channel, which is written by its name");
    lightCommand(address, timing, "");
}

void FrameWriter::namedCommand(std::int32_t effectType, std::string_view latin1Name, const ZephLightTiming& timing) {
    require(!latin1Name.empty() && latin1Name.size() <= 999, "a channel name has 1 to 999 characters");
    require(latin1Name.find(kStartOfFrame) == std::string_view::npos &&
                latin1Name.find(kEndOfFrame) == std::string_view::npos,
            "a channel name holds a control byte of the frame");
    lightCommand({.EffectType = effectType, .Circuit = static_cast<std::int32_t>(latin1Name.size())}, timing,
                 latin1Name);
}

void FrameWriter::lightCommand(const ZephLightCommand& address, const ZephLightTiming& timing, std::string_view key) {
    const std::int32_t fullLevel = address.EffectType == 3 ? 255 : 100;
    require(within(address.EffectType, 0, 3), "the effect type is not 0 to 3");
    require(within(address.Network, 0, 999), "the network is not 0 to 999");
    require(within(address.DeviceType, 0, 99), "the device type is not 0 to 99");
    require(within(address.Unit, 0, 999), "the unit is not 0 to 999");
    require(within(address.Circuit, 0, 999), "the circuit is not 0 to 999");
    require(within(timing.Duration, 0, 9'999'999), "the duration is not 0 to 9,999,999 ms");
    require(within(timing.StartIntensity, 0, fullLevel), "the start level is outside its scale");
    require(within(timing.EndIntensity, 0, fullLevel), "the end level is outside its scale");
    appendDigits(payloads_, kCmdLight, 2);
    appendDigits(payloads_, address.EffectType, 2);
    appendDigits(payloads_, address.Network, 3);
    appendDigits(payloads_, address.DeviceType, 2);
    appendDigits(payloads_, address.Unit, 3);
    appendDigits(payloads_, address.Circuit, 3);
    appendDuration(payloads_, timing.Duration);
    appendDigits(payloads_, timing.StartIntensity, 3);
    appendDigits(payloads_, timing.EndIntensity, 3);
    payloads_.append(key);
    ++payloadCount_;
}

void FrameWriter::dmxDump(std::int32_t universe, std::span<const std::uint8_t> levels) {
    require(within(universe, kFirstUniverse, kLastUniverse), "the universe is not 1 to 999");
    dump(universe, kDumpDmx, 0, levels);
}

void FrameWriter::controllerDump(std::int32_t network, std::int32_t unit, std::span<const std::uint8_t> levels) {
    require(within(network, kFirstNetwork, kLastNetwork), "the network is not 0 to 15");
    require(within(unit, kFirstUnit, kLastUnit), "the unit is not 1 to 240");
    dump(network, kDumpController, unit, levels);
}

void FrameWriter::dump(std::int32_t network, std::int32_t deviceType, std::int32_t unit,
                       std::span<const std::uint8_t> levels) {
    constexpr std::string_view hexDigits = "0123456789ABCDEF";
    require(levels.size() <= 999, "a dump has at most 999 levels");
    appendDigits(payloads_, kCmdDump, 2);
    appendDigits(payloads_, 0, 2);
    appendDigits(payloads_, network, 3);
    appendDigits(payloads_, deviceType, 2);
    appendDigits(payloads_, unit, 3);
    appendDigits(payloads_, static_cast<std::int32_t>(levels.size()), 3);
    for (const std::uint8_t level : levels) {
        payloads_ += hexDigits[level / 16];
        payloads_ += hexDigits[level % 16];
    }
    ++payloadCount_;
}

void FrameWriter::noOperation() {
    appendDigits(payloads_, kCmdNoOperation, 2);
    appendDigits(payloads_, 0, 2);
    ++payloadCount_;
}

std::size_t FrameWriter::size() const {
    return kHeaderChars + payloads_.size() + 2;  // 2: SOH and EOT
}

std::string FrameWriter::takeFrame() {
    require(payloadCount_ <= kMostPayloads, "a frame has at most 999 payloads");
    const std::size_t length = kHeaderChars + payloads_.size();
    require(length <= kMostLength, "a frame is at most 9999 characters long");
    std::string frame;
    frame.reserve(size());
    frame += kStartOfFrame;
    appendDigits(frame, payloadCount_, 3);
    appendDigits(frame, static_cast<std::int32_t>(length), 4);
    frame += payloads_;
    frame += kEndOfFrame;
    payloads_.clear();
    payloadCount_ = 0;
    return frame;
}
