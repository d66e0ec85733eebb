// A host that records what was shown and answers from a script, and a failure report that collects.
#pragma once

#include "util/failure.h"
#include "util/host.h"

#include <array>
#include <deque>
#include <string>
#include <vector>

class RecordingHost : public Host {
public:
    struct Box {
        std::string title;
        std::string text;
        BoxIcon icon;
    };

    BoxAnswer messageBox(std::string_view title, std::string_view text, BoxIcon icon, BoxButtons buttons) override {
        boxes.push_back({std::string(title), std::string(text), icon});
        if (answers.empty()) return buttons == BoxButtons::Ok ? BoxAnswer::Ok : BoxAnswer::No;
        const BoxAnswer answer = answers.front();
        answers.pop_front();
        return answer;
    }
    void setStatusPanel(int panel, std::string_view text) override {
        panels.at(static_cast<std::size_t>(panel)) = text;
        if (panel == 2) panel2History.emplace_back(text);
    }
    void setBusyPointer(bool busy) override { busyPointer = busy; }
    void showCompileErrors(std::string_view text) override { compileErrors.emplace_back(text); }
    void pumpEvents() override {}

    // "title|text" of each box, a line each.
    std::string boxTexts() const {
        std::string lines;
        for (const Box& box : boxes)
            lines += (lines.empty() ? "" : "\n") + box.title + "|" + box.text;
        return lines;
    }

    std::vector<Box> boxes;
    std::deque<BoxAnswer> answers;
    std::array<std::string, 5> panels;  // 1..4
    std::vector<std::string> panel2History;
    std::vector<std::string> compileErrors;
    bool busyPointer = false;
};

class CollectingFailures : public FailureReport {
public:
    struct Report {
        std::string description;
        std::string procedure;
        int line;

        bool operator==(const Report&) const = default;
    };
    void ErrReport(std::string_view description, std::string_view procedure, int line) override {
        reports.push_back({std::string(description), std::string(procedure), line});
    }
    std::vector<Report> reports;
};
