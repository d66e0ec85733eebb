// The log of failures: "errorlog.txt" in the System folder, one line a report, opened and closed for each, so that
// two processes can write to it in turn.
#pragma once

#include "util/failure.h"
#include "util/host.h"

#include <string>

class ErrorLog : public FailureReport {
public:
    // file: full path of the log. showNextError: the first report of the run also shows a box.
    ErrorLog(std::string file, bool showNextError, Host& host)
        : file_(std::move(file)), showNextError_(showNextError), host_(host) {}

    void ErrReport(std::string_view description, std::string_view procedure, int line) override;

    // Appends "yyyy-MM-dd hh:mm:ss", ":" and the message on one line. A log that cannot be written stays silent:
    // there is nowhere left to report to.
    void ZephLogError(std::string_view message);

    // Appends a line that is no failure: what the system granted, say. Shows nothing.
    void note(std::string_view message);

private:
    std::string file_;
    bool showNextError_;
    Host& host_;
};
