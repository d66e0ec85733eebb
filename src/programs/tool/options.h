// The command line of zeph-tool as a record.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

struct ToolOptions {
    std::string command;  // info, table, trace, render, send, record, demo-show, convert
    bool help = false;
    std::string file;        // the display, or for send the capture
    std::string secondFile;  // convert: the file to write
    std::string capture;
    std::string out;
    std::string engine = "standard";
    std::string host = "127.0.0.1";
    std::string address = "127.0.0.1";
    std::optional<std::int32_t> until;
    std::optional<std::int32_t> at;
    std::optional<std::int32_t> from;
    std::optional<std::int32_t> to;
    std::optional<std::int32_t> seconds;
    std::int32_t fps = 25;
    std::int32_t port = 30303;
    std::uint64_t seed = 1;
    double speed = 1.0;
    bool json = false;
    bool tcp = false;
    bool loop = false;
    bool force = false;
    bool onRequest = false;
};

struct ParsedOptions {
    ToolOptions options;
    std::string problem;  // what is wrong with the call; empty = nothing
};

// args without the program's name.
ParsedOptions parseToolOptions(const std::vector<std::string>& args);

// The usage of one command, or of all of them for "" and unknown names; several lines.
std::string toolUsage(const std::string& command);

// Everything that --help tells, for one command or for the tool.
std::string toolHelp(const std::string& command);
