// What every benchmark hands its figures to, and how they are taken: rows of times in groups, whose first row is the
// one that the others are compared with, and the goals that the program holds itself to.
// Not by a benchmark library: those measure one subject after the other, and the ratios here are between things that
// must be measured in turns, each after a preparation that does not count.
#pragma once

#include <algorithm>
#include <chrono>
#include <string>
#include <vector>

class BenchReport {
public:
    struct Row {
        std::string group;
        std::string name;
        double microseconds;
    };
    struct Goal {
        std::string name;
        std::string figure;
        std::string goal;
        bool met;
    };

    void row(std::string group, std::string name, double microseconds) {
        rows.push_back({std::move(group), std::move(name), microseconds});
    }
    void goal(std::string name, std::string figure, std::string goalText, bool met) {
        goals.push_back({std::move(name), std::move(figure), std::move(goalText), met});
    }

    // To standard output: a table of the rows, unless goalsOnly, and one line a goal.
    void print(bool goalsOnly) const;

    std::vector<Row> rows;
    std::vector<Goal> goals;
};

template <typename Work>
double microsecondsOf(Work work) {
    using SteadyClock = std::chrono::steady_clock;
    const SteadyClock::time_point start = SteadyClock::now();
    work();
    return std::chrono::duration<double, std::micro>(SteadyClock::now() - start).count();
}

// values is not empty.
inline double medianOf(std::vector<double> values) {
    const auto middle = values.begin() + static_cast<std::ptrdiff_t>(values.size() / 2);
    std::nth_element(values.begin(), middle, values.end());
    return *middle;
}

// The median time of `runs` calls, in microseconds. Before each, `prepare` runs outside the clock. runs is at least 1.
template <typename Prepare, typename Work>
double medianMicroseconds(int runs, Prepare prepare, Work work) {
    std::vector<double> times;
    for (int run = 0; run < runs; ++run) {
        prepare();
        times.push_back(microsecondsOf(work));
    }
    return medianOf(std::move(times));
}

template <typename Work>
double medianMicroseconds(int runs, Work work) {
    return medianMicroseconds(
        runs, [] {}, work);
}

// Keeps the compiler from dropping work whose result nothing reads.
template <typename T>
void keepResult(const T& value) {
    asm volatile("" : : "g"(&value) : "memory");
}

// One a bench file, called by main in this order.
void benchLoad(BenchReport& report);
void benchUndo(BenchReport& report);
void benchObjectFiles(BenchReport& report);
void benchParser(BenchReport& report);
void benchCommands(BenchReport& report);
void benchCompile(BenchReport& report);
void benchMasks(BenchReport& report);
void benchBlend(BenchReport& report);
void benchFrame(BenchReport& report);
void benchGL(BenchReport& report);
