// Makes a capture that shows off a display: every channel is addressed, and every kind of command of the stream is
// used. The same display and length give the same show.
#pragma once

#include "link/capture_file.h"
#include "programs/tool/show_cast.h"

inline constexpr std::int32_t kShortestShowMs = 5'000;
inline constexpr std::int32_t kDefaultShowMs = 45'000;
inline constexpr std::int32_t kLongestShowMs = 600'000;

// Pieces in order of time, from 0 to lengthMs (kept within the bounds above). Dark at both ends, so that a loop joins.
std::vector<CapturePiece> ZephMakeDemoShow(const ShowCast& cast, std::int32_t lengthMs);
