// A host without a window: prints each message box as one line "TITLE | TEXT" to a stream, line breaks in TEXT shown
// as " / ", and keeps what was shown. Questions are answered with the first refusal offered (No, else Cancel).
#pragma once

#include "util/host.h"

#include <cstdio>
#include <vector>

class MessageHost : public Host {
public:
    struct Message {
        std::string title;
        std::string text;
    };

    explicit MessageHost(std::FILE* stream) : stream_(stream) {}

    BoxAnswer messageBox(std::string_view title, std::string_view text, BoxIcon icon, BoxButtons buttons) override;
    void setStatusPanel(int, std::string_view) override {}
    void setBusyPointer(bool) override {}
    void showCompileErrors(std::string_view text) override;
    void pumpEvents() override {}

    const std::vector<Message>& messages() const { return messages_; }
    const std::string& compileErrors() const { return compileErrors_; }

private:
    void print(std::string_view title, std::string_view text);

    std::FILE* stream_;
    std::vector<Message> messages_;
    std::string compileErrors_;
};

// The text on one line: each line break (CR LF, CR or LF) becomes " / ".
std::string onOneLine(std::string_view text);
