// ZephUIState: what the window is doing. Undo steps remember it and return to it.
#pragma once

inline constexpr int kStateSimulation = 1;
inline constexpr int kStateSelectProp = 2;
inline constexpr int kStateSelectFixture = 3;
inline constexpr int kStateDrawing = 4;
