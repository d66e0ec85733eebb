#include "link/queue_gauge.h"
#include "util/color.h"

TEST(QueueGauge, ColoursByRatioAndSendsAColourOnlyWhenItChanges) {
    constexpr std::int32_t green = packColor(0, 255, 0);
    const std::tuple<std::size_t, std::optional<std::int32_t>, std::int32_t> rows[] = {
        {0, green, 0},
        {1'468'006, std::nullopt, 1'468'006},            // 0.69999980
        {1'468'007, packColor(255, 255, 0), 1'468'007},  // 0.70000029
        {1'887'436, std::nullopt, 1'887'436},            // 0.89999962
        {1'887'437, packColor(255, 0, 0), 1'887'437},    // 0.90000010
        {5'000'000'000, std::nullopt, 2'097'152},
        {7, green, 7},
    };
    QueueGauge gauge;
    for (const auto& [length, color, value] : rows) {
        const QueueGaugeUpdate update = ZephUpdateQueueGauge(length, false, gauge);
        EXPECT_EQ(update.color, color) << length;
        EXPECT_EQ(update.value, value) << length;
    }
    const QueueGaugeUpdate silent = ZephUpdateQueueGauge(2'000'000, true, gauge);
    EXPECT_FALSE(silent.color || silent.value);
    EXPECT_FALSE(ZephUpdateQueueGauge(8, false, gauge).color);  // what OpenGL hid was not sent
}
