// The table through which every level becomes the brightness that is drawn. One for the whole program, read at
// start-up from "standarddimmingcurve.xml"; the program never writes it.
#pragma once

#include "util/failure.h"

#include <array>
#include <cstdint>
#include <string>

namespace pugi {
class xml_node;
}

using ZephDimmingCurve = std::array<std::uint8_t, 256>;  // output intensity 0..255, by input intensity 0..255

// The identity: what goes in comes out. It stands in when the file cannot be read.
ZephDimmingCurve ZephCreateDummyDimmingCurve();

// Reads a curve file. Inputs that it does not name keep what the curve held. False, with a report, when the file is
// not there, is no curve or is damaged; the curve may then be partly filled.
[[nodiscard]] bool ZephLoadDimmingCurveXML(const std::string& path, FailureReport& failures, ZephDimmingCurve& curve);

// The same for a text in memory.
[[nodiscard]] bool loadDimmingCurveText(std::string_view text, FailureReport& failures, ZephDimmingCurve& curve);

// The body of a version 1.5.0 file: every child of Dimming_Curve, whatever its name, sets one value.
[[nodiscard]] bool LoadDimmingCurveVersion150(const pugi::xml_node& root, FailureReport& failures,
                                              ZephDimmingCurve& curve);
