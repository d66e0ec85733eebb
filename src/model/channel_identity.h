// What makes two channel records the same channel, how a channel's address is shown, and the editor's warning when one
// channel drives more fixtures than a simulation keeps.
#pragma once

#include "model/simulation.h"
#include "util/host.h"

// True when the device types agree and, with them, the fields that the device type uses.
bool sameChannel(const ZephChannel& left, const ZephChannel& right);

// The address in lines of the form "Label:value", each ending in CR LF, by the device type's own labels.
std::string channelAddressLines(const ZephChannel& channel);

// An X10 address: house "A".."P" = value / 16, unit = value modulo 16, plus 1.
std::string ZephReturnX10HouseCode(std::int32_t value);
std::string ZephReturnX10UnitCode(std::int32_t value);

// Warns, one box a channel, when a named channel of the fixture (a copy under edit) drives 16 or more fixtures.
void ZephCheckFixturesPerChannel(const ZephSimulation& simulation, const ZephFixture& fixture, Host& host);
