// Builds frames of the channel stream as a sender does: for the demo show, the tests and the benchmarks. The program
// itself only receives.
// Every procedure throws Failure when a value does not fit its field; the frame then stays as it was.
#pragma once

#include "link/light_command.h"

#include <cstdint>
#include <span>
#include <string>
#include <string_view>

class FrameWriter {
public:
    static constexpr std::int32_t kMostPayloads = 999;  // three digits of payload count
    static constexpr std::int32_t kMostLength = 9999;   // four digits of frame length, header included

    // A light command for a channel with an address. EffectType 0..3 becomes the subtype; Network, Unit and Circuit
    // are 0..999, DeviceType 0..99, and Network, DeviceType and Unit must not all be 0: that addresses a virtual
    // channel. CommandType is not looked at. Duration 0..9,999,999 ms. Intensities 0..100, for EffectType 3 0..255.
    void command(const ZephLightCommand& address, const ZephLightTiming& timing);

    // The same for a virtual channel, by its name: 1..999 Latin-1 bytes without SOH and EOT.
    void namedCommand(std::int32_t effectType, std::string_view latin1Name, const ZephLightTiming& timing);

    // Levels 0..255 of a DMX universe 1..999, from channel 1 on; at most 999 levels.
    void dmxDump(std::int32_t universe, std::span<const std::uint8_t> levels);

    // Levels 0..255 of the controller with that network 0..15 and unit 1..240, from circuit 1 on; at most 999 levels.
    void controllerDump(std::int32_t network, std::int32_t unit, std::span<const std::uint8_t> levels);

    // A payload that receivers skip.
    void noOperation();

    std::int32_t payloadCount() const { return payloadCount_; }

    // Bytes of the frame as it stands, SOH and EOT included.
    std::size_t size() const;

    // The frame from SOH to EOT; empties the writer. Throws Failure over 999 payloads or a frame length over 9999, and
    // then keeps what it holds.
    std::string takeFrame();

private:
    void lightCommand(const ZephLightCommand& address, const ZephLightTiming& timing, std::string_view key);
    void dump(std::int32_t network, std::int32_t deviceType, std::int32_t unit, std::span<const std::uint8_t> levels);

    std::string payloads_;
    std::int32_t payloadCount_ = 0;
};
