// The gauge of the receive queue: how full the buffer is, as a bar that turns yellow and red. Logic only; the window
// carries out what it is told.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>

// The gauge's range ends where the socket's receive buffer does.
inline constexpr std::int32_t kQueueGaugeMax = 2'097'152;  // characters

struct QueueGauge {
    std::int32_t colorSent = -1;  // packed colour that the control has; -1 = none was sent yet
};

// What the control is to be told.
struct QueueGaugeUpdate {
    std::optional<std::int32_t> color;  // packed; nothing where the control has it already
    std::optional<std::int32_t> value;  // 0..kQueueGaugeMax
};

// length: characters in the buffer. Red above 0.9 of the range, yellow above 0.7, green otherwise. Nothing at all while
// OpenGL is the output, which shows no gauge.
QueueGaugeUpdate ZephUpdateQueueGauge(std::size_t length, bool openGlOutput, QueueGauge& gauge) noexcept;
