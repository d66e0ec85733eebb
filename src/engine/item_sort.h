// Shares bulbs out among the parts of the canvas that they touch, the order of painting kept within each part: a
// counting sort, for the plan at entry and for the lists of each frame.
#pragma once

#include "engine/blend.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <vector>

// forEach(visit) calls visit(item) for all items, twice the same. forPlaces(item, visit) calls visit(part) for each
// part, from 0, that the item touches. first has one place more than parts: afterwards the items of part p are
// sorted[first[p]] to sorted[first[p + 1] - 1]. sorted only ever grows; where it is long enough nothing is allocated.
template <typename ForEach, typename ForPlaces>
void sortItems(ForEach forEach, ForPlaces forPlaces, std::vector<BulbItem>& sorted, std::vector<std::int32_t>& first) {
    std::fill(first.begin(), first.end(), 0);
    const std::size_t parts = first.size() - 1;
    std::size_t total = 0;
    // Counted one place on, so that after the second round each part's number is where its items begin.
    forEach([&](const BulbItem& item) {
        forPlaces(item, [&](std::size_t part) {
            ++total;
            if (part + 2 <= parts) ++first[part + 2];
        });
    });
    for (std::size_t part = 2; part <= parts; ++part)
        first[part] += first[part - 1];
    if (sorted.size() < total) sorted.resize(total);
    forEach([&](const BulbItem& item) {
        forPlaces(item, [&](std::size_t part) { sorted[static_cast<std::size_t>(first[part + 1]++)] = item; });
    });
}
