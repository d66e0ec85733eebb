// Compiling the render table, beside the same addresses put into the standard library's ordered map.
#include "bench/bench_display.h"
#include "bench/bench_report.h"
#include "tests/support/limit_document.h"

#include <cstdio>
#include <map>

namespace {

// The sorted collection alone: no bulbs, no groups, no levels.
double intoMap(const ZephRenderTables& tables) {
    std::vector<std::pair<std::int32_t, ZephRenderSlot>> addresses;
    for (std::size_t e = 1; e < tables.RenderData.size(); ++e) {
        const ZephRenderData& entry = tables.RenderData[e];
        for (std::int32_t s = entry.FirstSlot; s < entry.FirstSlot + entry.SlotCount; ++s) {
            addresses.emplace_back(entry.Key, tables.Slots[static_cast<std::size_t>(s)]);
        }
    }
    return medianMicroseconds(5, [&] {
        std::map<std::int32_t, std::vector<ZephRenderSlot>> map;
        for (const auto& [key, slot] : addresses)
            map[key].push_back(slot);
        keepResult(map.size());
    });
}

double compileTime(BenchDisplay& display) {
    return medianMicroseconds(
        9, [&] { restoreAssembledPoints(*display.simulation, *display.states); }, [&] { display.compile(); });
}

}  // namespace

void benchCompile(BenchReport& report) {
    BenchDisplay limit;
    buildLimitDocument(*limit.simulation);
    const double limitTime = compileTime(limit);
    report.row("Compile the limit document", "its addresses into a std::map", intoMap(limit.tables));
    report.row("Compile the limit document", "render table, all of it", limitTime);

    BenchDisplay ribbons;
    buildRibbons(*ribbons.simulation, kMaxFixtures);
    const double ribbonTime = compileTime(ribbons);
    report.row("Compile 1024 ribbons", "their addresses into a std::map", intoMap(ribbons.tables));
    report.row("Compile 1024 ribbons", "render table, all of it", ribbonTime);

    char figure[96];
    std::snprintf(figure, sizeof figure, "%.1f ms; %.1f ms for %d keys", limitTime / 1000, ribbonTime / 1000,
                  ribbons.tables.RenderDataCount);
    report.goal("compile", figure, "at most 60 ms; at most 150 ms", limitTime <= 60'000 && ribbonTime <= 150'000);
}
