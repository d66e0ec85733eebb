// The channel stream's numbers, for whoever writes or reads it: control bytes, payload types, widths in characters and
// the ranges of addresses. docs/stream.md tells the format.
#pragma once

#include <cstddef>
#include <cstdint>

inline constexpr char kStartOfFrame = '\x01';  // SOH
inline constexpr char kEndOfFrame = '\x04';    // EOT; ends the frame wherever it stands

inline constexpr std::size_t kHeaderChars = 7;       // payload count (3) and frame length (4)
inline constexpr std::size_t kPayloadHeadChars = 4;  // cmd (2) and sub (2)
inline constexpr std::size_t kAddressedChars = 15;   // head, network (3), device type (2), unit (3), circuit (3)

// Payload types.
inline constexpr std::int32_t kCmdLight = 0;
inline constexpr std::int32_t kCmdDump = 1;
inline constexpr std::int32_t kCmdNoOperation = 99;

// Device types that a level dump can address.
inline constexpr std::int32_t kDumpController = 1;
inline constexpr std::int32_t kDumpDmx = 7;

// Addresses of level dumps.
inline constexpr std::int32_t kFirstUniverse = 1;
inline constexpr std::int32_t kLastUniverse = 999;
inline constexpr std::int32_t kFirstNetwork = 0;
inline constexpr std::int32_t kLastNetwork = 15;
inline constexpr std::int32_t kFirstUnit = 1;
inline constexpr std::int32_t kLastUnit = 240;
