#include "util/message_host.h"

std::string boxTitle(std::string_view suffix) {
    return std::string(kProgramName).append(suffix);
}

std::string onOneLine(std::string_view text) {
    std::string line;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] != '\r' && text[i] != '\n') {
            line.push_back(text[i]);
            continue;
        }
        line += " / ";
        if (text[i] == '\r' && i + 1 < text.size() && text[i + 1] == '\n') ++i;
    }
    return line;
}

BoxAnswer MessageHost::messageBox(std::string_view title, std::string_view text, BoxIcon, BoxButtons buttons) {
    messages_.push_back({std::string(title), std::string(text)});
    print(title, text);
    switch (buttons) {
    case BoxButtons::Ok:
        return BoxAnswer::Ok;
    case BoxButtons::OkCancel:
        return BoxAnswer::Cancel;
    case BoxButtons::YesNo:
    case BoxButtons::YesNoCancel:
        return BoxAnswer::No;
    }
    return BoxAnswer::No;
}

void MessageHost::showCompileErrors(std::string_view text) {
    compileErrors_ = text;
    print(kProgramName, text);
}

void MessageHost::print(std::string_view title, std::string_view text) {
    const std::string line = std::string(title) + " | " + onOneLine(text) + "\n";
    std::fwrite(line.data(), 1, line.size(), stream_);
    std::fflush(stream_);
}
