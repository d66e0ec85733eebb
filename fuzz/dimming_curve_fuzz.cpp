// Any bytes as a dimming curve: an answer and, when it is no, a report.
#include "model/dimming_curve.h"
#include "tests/support/recording_host.h"

#include <cstdlib>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    CollectingFailures failures;
    ZephDimmingCurve curve = ZephCreateDummyDimmingCurve();
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    const bool loaded = loadDimmingCurveText(text, failures, curve);
    if (loaded != failures.reports.empty()) std::abort();
    return 0;
}
