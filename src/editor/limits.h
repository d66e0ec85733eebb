// The most that a document takes, told to whoever wants more.
#pragma once

#include "model/simulation.h"
#include "util/host.h"

// Whether one more fits. A full document is told in a box.
[[nodiscard]] bool fixtureFits(const ZephSimulation& simulation, Host& host);
[[nodiscard]] bool propFits(const ZephSimulation& simulation, Host& host);
