// Prints every benchmark as a table, each row beside the first of its group; with --goals only the goal lines. Names of
// subjects choose among them.
#include "bench/bench_report.h"

#include <algorithm>
#include <cstdio>
#include <span>
#include <string_view>

namespace {

struct Subject {
    std::string_view name;
    void (*measure)(BenchReport& report);
};

constexpr Subject kSubjects[] = {
    {"load", benchLoad},         {"undo", benchUndo},       {"objects", benchObjectFiles}, {"parser", benchParser},
    {"commands", benchCommands}, {"compile", benchCompile}, {"masks", benchMasks},         {"blend", benchBlend},
    {"frame", benchFrame},       {"gl", benchGL},
};

int usage(const char* program) {
    std::fprintf(stderr, "usage: %s [--goals] [SUBJECT...]\nsubjects:", program);
    for (const Subject& subject : kSubjects)
        std::fprintf(stderr, " %s", subject.name.data());
    std::fprintf(stderr, "\n");
    return 2;
}

}  // namespace

int main(int count, char** arguments) {
    const std::vector<std::string_view> given(arguments + 1, arguments + count);
    const bool goalsOnly = !given.empty() && given.front() == "--goals";
    const std::span<const std::string_view> chosen = std::span(given).subspan(goalsOnly ? 1 : 0);
    for (const std::string_view name : chosen) {
        if (std::ranges::find(kSubjects, name, &Subject::name) == std::end(kSubjects)) return usage(arguments[0]);
    }
    BenchReport report;
    for (const Subject& subject : kSubjects) {
        if (chosen.empty() || std::ranges::find(chosen, subject.name) != chosen.end()) subject.measure(report);
    }
    report.print(goalsOnly);
    return 0;
}
