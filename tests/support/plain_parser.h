// The channel stream's parser as anyone would write it first: substrings, std::stoi, text cut off the front. The
// program's parser is compared with it in tests and fuzzing and measured beside it; it shares no code with it.
#pragma once

#include "link/light_command.h"

#include <cstdint>
#include <map>
#include <stdexcept>
#include <string>
#include <utility>

struct PlainParser {
    std::string buffer;
    ZephLightTiming timing;
    std::uint32_t serial = 0;
    std::map<int, std::string> dmxDumps;                         // levels as bytes, by universe
    std::map<std::pair<int, int>, std::string> controllerDumps;  // by network and unit
    bool dmxPending = false;
    bool controllerPending = false;

    void process(CommandSink& sink) {
        while (!buffer.empty()) {
            if (buffer[0] != '\x01') {
                const std::size_t start = buffer.find('\x01');
                if (start == std::string::npos || start == buffer.size() - 1) {
                    buffer.clear();
                    return;
                }
                buffer.erase(0, start);
            }
            const std::size_t end = buffer.find('\x04');
            if (end == std::string::npos) return;
            const std::string body = buffer.substr(1, end - 1);
            buffer.erase(0, end + 1);
            try {
                if (!frame(body, sink)) return;
            } catch (const std::exception&) {
                return;
            }
        }
    }

private:
    static int whole(const std::string& text) {
        if (text.empty() || text.find_first_not_of("0123456789") != std::string::npos) {
            throw std::invalid_argument("not a number");
        }
        return static_cast<int>(std::stol(text));
    }

    // Long division by hand: the digits in front of the point and one behind it are ms, the rest decides the rounding.
    static int duration(const std::string& text) {
        const std::size_t point = text.find('.');
        std::string before = text.substr(0, point);
        std::string behind = point == std::string::npos ? "" : text.substr(point + 1);
        behind += "00";
        whole(before + behind);
        const std::string rest = behind.substr(1);
        const int ms = static_cast<int>(std::stol(before + behind[0]));
        const std::string half = "5" + std::string(rest.size() - 1, '0');
        return ms + (rest > half || (rest == half && ms % 2 == 1) ? 1 : 0);
    }

    static int level(int value, int sub) {
        const int percent = sub == 3 ? static_cast<int>(value / 255.0 * 100.0 + 0.5) : value;
        return percent > 100 ? 100 : percent;
    }

    static std::string bytes(const std::string& digits) {
        std::string result;
        for (std::size_t i = 0; i + 1 < digits.size(); i += 2) {
            const std::string pair = digits.substr(i, 2);
            if (pair.find_first_not_of("0123456789abcdefABCDEF") != std::string::npos) {
                throw std::invalid_argument("not hexadecimal");
            }
            result += static_cast<char>(std::stoi(pair, nullptr, 16));
        }
        return result;
    }

    bool frame(std::string rest, CommandSink& sink) {
        if (rest.size() < 7) return false;
        const int count = whole(rest.substr(0, 3));
        const int length = whole(rest.substr(3, 4));
        if (length != static_cast<int>(rest.size())) return false;
        rest.erase(0, 7);
        for (int payload = 1; payload <= count; ++payload) {
            ++serial;
            if (rest.size() < 4) return false;
            const int cmd = whole(rest.substr(0, 2));
            const int sub = whole(rest.substr(2, 2));
            if (cmd == 99) rest.erase(0, 4);
            if (cmd > 1) continue;
            if (rest.size() < 15) return false;
            const int network = whole(rest.substr(4, 3));
            const int device = whole(rest.substr(7, 2));
            const int unit = whole(rest.substr(9, 3));
            const int circuit = whole(rest.substr(12, 3));
            if (cmd == 1) {
                const std::string digits = rest.substr(15, 2 * static_cast<std::size_t>(circuit));
                if (device == 7 && network >= 1 && network <= 999) {
                    dmxDumps[network] = bytes(digits);
                    dmxPending = true;
                }
                if (device == 1 && network <= 15 && unit >= 1 && unit <= 240) {
                    controllerDumps[{network, unit}] = bytes(digits);
                    controllerPending = true;
                }
                rest.erase(0, 15 + 2 * static_cast<std::size_t>(circuit));
                continue;
            }
            ZephLightCommand command{0, sub, network, device, unit, circuit};
            std::size_t cut = 29;
            if (network == 0 && device == 0 && unit == 0) {
                cut += static_cast<std::size_t>(circuit);
                if (rest.size() <= 29 || rest.size() < cut) return false;
                command.Circuit = sink.virtualChannelKey(rest.substr(29, cut - 29));
                if (command.Circuit == 0) {
                    rest.erase(0, cut);
                    continue;
                }
            }
            if (sub <= 3) {
                if (rest.size() < cut) return false;
                const int ms = duration(rest.substr(15, 8));
                const int start = whole(rest.substr(23, 3));
                const int end = whole(rest.substr(26, 3));
                timing = {ms, level(start, sub), level(end, sub)};
                rest.erase(0, cut);
            }
            const ZephChannelCommand one{command, timing};
            sink.addLightCommands({&one, 1});
        }
        return true;
    }
};
