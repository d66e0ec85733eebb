// A fixed array counted from 1, as the records of a display are numbered; number 0 means none.
#pragma once

#include "util/failure.h"

#include <array>
#include <cassert>

template <typename T, int N>
class OneBased {
public:
    static constexpr int kSize = N;

    // For numbers that our own loops made: 1..N.
    T& operator[](int number) noexcept {
        assert(contains(number));
        return items_[static_cast<std::size_t>(number - 1)];
    }
    const T& operator[](int number) const noexcept {
        assert(contains(number));
        return items_[static_cast<std::size_t>(number - 1)];
    }

    // For numbers from files, packets and users: throws Failure, with the caller's line, outside 1..N.
    T& at(int number, SourceLine where = SourceLine::current()) {
        require(contains(number), "Subscript out of range", where);
        return (*this)[number];
    }
    const T& at(int number, SourceLine where = SourceLine::current()) const {
        require(contains(number), "Subscript out of range", where);
        return (*this)[number];
    }

    static constexpr bool contains(int number) noexcept { return number >= 1 && number <= N; }
    void fill(const T& value) { items_.fill(value); }

    auto begin() noexcept { return items_.begin(); }
    auto end() noexcept { return items_.end(); }
    auto begin() const noexcept { return items_.begin(); }
    auto end() const noexcept { return items_.end(); }

    bool operator==(const OneBased&) const = default;

private:
    std::array<T, static_cast<std::size_t>(N)> items_{};
};
