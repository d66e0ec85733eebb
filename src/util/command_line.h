// The command line of the window program: at most one editor file and the switch "showerror".
#pragma once

#include <string>
#include <string_view>
#include <vector>

struct CommandLineParms {
    std::string FileToOpen;      // as given; empty = none
    bool ShowNextError = false;  // the first failure report of the run shows a box
};

// The text of a command line whose arguments were parted already: each with a blank or tab in it, or empty, stands in
// double quotes.
std::string commandLineText(const std::vector<std::string>& args);

// Splits a command line into at most maxArgs arguments. Blanks and tabs part them outside double quotes; the quote
// characters are dropped.
std::vector<std::string> GetCommandLine(std::string_view commandLine, int maxArgs);

// "showerror" in any case sets the switch; the last other argument is the file to open; the rest has no meaning.
CommandLineParms ProcessCommandLineParms(std::vector<std::string> args);
