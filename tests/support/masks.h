// Every mask and outline under the straight curve, made once in a program: they never change.
#pragma once

#include "engine/bulb_masks.h"
#include "model/dimming_curve.h"

#include <memory>

inline std::unique_ptr<ZephMasks> makeMasks(const ZephDimmingCurve& curve) {
    auto made = std::make_unique<ZephMasks>();
    const auto quietly = [](std::string_view) {};
    ZephSetUpMasks(curve, quietly, *made);
    return made;
}

inline const ZephMasks& masks() {
    static const std::unique_ptr<ZephMasks> made = makeMasks(ZephCreateDummyDimmingCurve());
    return *made;
}
