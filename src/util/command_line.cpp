#include "util/command_line.h"

#include "util/text.h"

std::string commandLineText(const std::vector<std::string>& args) {
    std::string text;
    for (const std::string& arg : args) {
        const bool quoted = arg.empty() || arg.find_first_of(" \t") != std::string::npos;
        text.append(text.empty() ? "" : " ").append(quoted ? "\"" + arg + "\"" : arg);
    }
    return text;
}

std::vector<std::string> GetCommandLine(std::string_view commandLine, int maxArgs) {
    std::vector<std::string> args;
    bool quoted = false;
    bool started = false;
    for (const char letter : commandLine) {
        if (letter == '"') {
            quoted = !quoted;
        } else if ((letter == ' ' || letter == '\t') && !quoted) {
            started = false;
        } else {
            if (!started) {
                if (static_cast<int>(args.size()) == maxArgs) break;
                args.emplace_back();
                started = true;
            }
            args.back().push_back(letter);
        }
    }
    return args;
}

CommandLineParms ProcessCommandLineParms(std::vector<std::string> args) {
    CommandLineParms parms;
    for (std::string& arg : args) {
        if (!equalIgnoringCase(arg, "showerror")) continue;
        parms.ShowNextError = true;
        arg.clear();
    }
    for (const std::string& arg : args) {
        if (!trimmed(arg).empty()) parms.FileToOpen = arg;
    }
    return parms;
}
