#include "editor/limits.h"

namespace {

bool fits(std::int32_t count, int most, const char* what, Host& host) {
    if (count < most) return true;
    host.messageBox(boxTitle("-Error"),
                    "You have created the maximum number (" + std::to_string(most) + ") of " + what + ".",
                    BoxIcon::Critical);
    return false;
}

}  // namespace

bool fixtureFits(const ZephSimulation& simulation, Host& host) {
    return fits(simulation.FixtureCount, kMaxFixtures, "fixtures", host);
}

bool propFits(const ZephSimulation& simulation, Host& host) {
    return fits(simulation.PropCount, kMaxProps, "props", host);
}
