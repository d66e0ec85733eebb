#include "programs/tool/options.h"

#include "util/text.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <string_view>

namespace {

struct CommandRow {
    std::string_view name;
    std::string_view usage;
    std::string_view allowed;  // the switches it takes, each between blanks
    std::string_view needed;
    std::string_view help;
    std::size_t files = 1;  // how many it is called with
};

constexpr std::array<CommandRow, 8> kCommands{{
    {"info", "info FILE.zee [--json]", " --json ", "",
     "Loads the display and tells what is in it. --json prints every record. Exit status 1 where the file could not "
     "be\n"
     "read whole; what was read is printed all the same."},
    {"table", "table FILE.zee [--json]", " --json ", "",
     "Loads, checks and compiles the display as a simulation does and tells the render table: keys and what each\n"
     "drives, virtual channels, RGB groups, bulb positions. Exit status 1 where nothing can be simulated."},
    {"trace", "trace FILE.zee --capture CAP.zcap --until MS [--engine standard|opengl] [--seed N] [--json]",
     " --capture --until --engine --seed --json ", " --capture --until ",
     "Plays the capture on a clock of its own and tells, for every frame, what was drawn in which order. --json "
     "prints\n"
     "one document a line."},
    {"render",
     "render FILE.zee --capture CAP.zcap (--at MS --out FILE.png | --from MS --to MS --fps N --out FILE.mp4|FILE.gif|"
     "FOLDER/) [--engine standard|opengl] [--seed N]",
     " --capture --at --from --to --fps --out --engine --seed ", " --capture --out ",
     "Draws the first frame at or after a time as a picture, or a stretch of time as a film through the installed\n"
     "ffmpeg, or as numbered pictures in a folder. --engine opengl draws as the OpenGL window does, without a window:\n"
     "it needs a driver, of a graphics card or in software, but no screen. Exit status 1 where there is none."},
    {"send", "send CAP.zcap [--host 127.0.0.1] [--port 30303] [--tcp] [--loop] [--speed X] [--on-request]",
     " --host --port --tcp --loop --speed --on-request ", "",
     "Plays a capture to a listening simulation in real time, one datagram (UDP) or write (TCP) a piece. --on-request\n"
     "registers as the sequencing program and plays when the window's buttons ask for it, until it is stopped."},
    {"record", "record --out CAP.zcap [--port 30303] [--address 127.0.0.1] [--tcp] [--seconds N]",
     " --out --port --address --tcp --seconds ", " --out ",
     "Writes what arrives on the port as a capture, until it is stopped. A recording that is killed stays readable up\n"
     "to its last whole line.",
     0},
    {"demo-show", "demo-show FILE.zee --out CAP.zcap [--seconds N]", " --out --seconds ", " --out ",
     "Makes a capture that exercises every channel of the display: chases, fades, twinkle, shimmer, strobes, level\n"
     "dumps, ribbon motions and colour effects."},
    {"convert", "convert IN.zee OUT.zee [--force]", " --force ", "",
     "Loads a display of any version and writes it as one of the present version, with its checksum. A file that is\n"
     "already there is replaced only with --force. Nothing is written of a display that could not be read whole.",
     2},
}};

const CommandRow* rowOf(std::string_view command) {
    const auto row = std::ranges::find(kCommands, command, &CommandRow::name);
    return row == kCommands.end() ? nullptr : &*row;
}

bool holds(std::string_view list, const std::string& name) {
    return list.find(" " + name + " ") != std::string_view::npos;
}

// Takes the value of a switch into its field. False where the text is none of its values.
bool takeValue(const std::string& name, const std::string& text, ToolOptions& options) {
    const auto milliseconds = [&](std::optional<std::int32_t>& field, std::int32_t least) {
        field = parseLong(text);
        return field && *field >= least;
    };
    if (name == "--capture") return options.capture = text, !text.empty();
    if (name == "--out") return options.out = text, !text.empty();
    if (name == "--host") return options.host = text, !text.empty();
    if (name == "--address") return options.address = text, !text.empty();
    if (name == "--engine") return options.engine = text, text == "standard" || text == "opengl";
    if (name == "--until") return milliseconds(options.until, 0);
    if (name == "--at") return milliseconds(options.at, 0);
    if (name == "--from") return milliseconds(options.from, 0);
    if (name == "--to") return milliseconds(options.to, 0);
    if (name == "--seconds") return milliseconds(options.seconds, 1);
    if (name == "--fps") {
        options.fps = parseLong(text).value_or(0);
        return options.fps >= 1 && options.fps <= 1000;
    }
    if (name == "--port") {
        options.port = parseLong(text).value_or(0);
        return options.port >= 1 && options.port <= 65535;
    }
    const char* const end = text.data() + text.size();
    if (name == "--seed") {
        const auto [last, error] = std::from_chars(text.data(), end, options.seed);
        return error == std::errc() && last == end;
    }
    const auto [last, error] = std::from_chars(text.data(), end, options.speed);  // --speed
    return error == std::errc() && last == end && options.speed > 0 && options.speed <= 1000;
}

bool takeFlag(const std::string& name, ToolOptions& options) {
    if (name == "--json") return options.json = true;
    if (name == "--tcp") return options.tcp = true;
    if (name == "--loop") return options.loop = true;
    if (name == "--force") return options.force = true;
    if (name == "--on-request") return options.onRequest = true;
    return false;
}

std::string renderProblem(const ToolOptions& options) {
    if (options.at && (options.from || options.to)) return "--at and --from/--to exclude each other";
    if (options.at) return "";
    if (!options.from || !options.to) return "render needs --at, or --from and --to";
    return *options.to < *options.from ? "--to lies before --from" : "";
}

std::string problemOf(const CommandRow& row, const std::vector<std::string>& given, const ToolOptions& options) {
    if (row.files > 0 && options.file.empty()) return "no file is named";
    if (row.files > 1 && options.secondFile.empty()) return "no file to write is named";
    std::string_view needed = row.needed;
    while (needed.size() > 1) {
        const std::size_t end = needed.find(' ', 1);
        const std::string name(needed.substr(1, end - 1));
        if (std::ranges::find(given, name) == given.end()) return name + " is missing";
        needed = needed.substr(end);
    }
    return row.name == "render" ? renderProblem(options) : "";
}

ParsedOptions wrong(ToolOptions options, const std::string& problem) {
    return {std::move(options), problem};
}

}  // namespace

ParsedOptions parseToolOptions(const std::vector<std::string>& args) {
    ToolOptions options;
    const auto isHelp = [](const std::string& arg) { return arg == "--help" || arg == "-h"; };
    if (args.empty()) return wrong(options, "no command is named");
    if (isHelp(args[0])) {
        options.help = true;
        return {options, ""};
    }
    options.command = args[0];
    const CommandRow* row = rowOf(options.command);
    if (!row) return wrong(options, "there is no command '" + options.command + "'");
    std::vector<std::string> given;
    std::size_t files = 0;
    for (std::size_t i = 1; i < args.size(); ++i) {
        const std::string& arg = args[i];
        if (isHelp(arg)) {
            options.help = true;
            return {options, ""};
        }
        if (!arg.starts_with("--")) {
            if (files == row->files) return wrong(options, "'" + arg + "' is one file too many");
            (files++ == 0 ? options.file : options.secondFile) = arg;
            continue;
        }
        if (!holds(row->allowed, arg)) return wrong(options, options.command + " does not take " + arg);
        given.push_back(arg);
        if (takeFlag(arg, options)) continue;
        if (++i == args.size()) return wrong(options, arg + " needs a value");
        if (!takeValue(arg, args[i], options)) return wrong(options, "'" + args[i] + "' is no value of " + arg);
    }
    std::string problem = problemOf(*row, given, options);
    return {std::move(options), std::move(problem)};
}

std::string toolUsage(const std::string& command) {
    if (const CommandRow* row = rowOf(command)) return "usage: zeph-tool " + std::string(row->usage) + "\n";
    std::string usage = "usage: zeph-tool COMMAND ... (zeph-tool --help tells more)\n";
    for (const CommandRow& row : kCommands)
        usage += "       zeph-tool " + std::string(row.usage) + "\n";
    return usage;
}

std::string toolHelp(const std::string& command) {
    constexpr std::string_view common =
        "\nResults go to standard output, messages to standard error (a message box as one line, TITLE | TEXT).\n"
        "Exit status: 0 done; 1 the input could not be used; 2 wrong usage.\n";
    constexpr std::string_view virtualTime =
        "\nVirtual time: trace and render run the simulation on a clock that reads 100000 when it begins and moves in\n"
        "ticks, of 9 ms for the standard engine and 15 ms for OpenGL. --seed N (default 1) seeds the random source, "
        "so\n"
        "the same call gives the same result on every machine.\n";
    constexpr std::string_view captures = "\nA capture (.zcap) is plain text: a first line 'zeph-capture 1', then a "
                                          "line for each piece of the stream: the\n"
                                          "milliseconds since the start, one blank, and the bytes, in which a "
                                          "backslash and every byte outside 0x20..0x7E\n"
                                          "stand as \\xHH. Empty lines and lines that begin with # are skipped.\n";
    std::string help = toolUsage(command);
    if (const CommandRow* row = rowOf(command)) {
        help += "\n" + std::string(row->help) + "\n";
        if (row->name == "trace" || row->name == "render") help += virtualTime;
        if (row->allowed.find("--capture") != std::string_view::npos ||
            row->help.find("capture") != std::string::npos) {
            help += captures;
        }
    } else {
        for (const CommandRow& entry : kCommands) {
            help += "\n" + std::string(entry.name) + "\n" + std::string(entry.help) + "\n";
        }
        help.append(virtualTime).append(captures);
    }
    return help.append(common);
}
