// Asking the sequencing program to start and stop playing: one record over a local socket. The other half, how a
// sequencing program listens, is what zeph-tool send --on-request does. docs/stream.md tells both.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

enum class SequencerCommand { Start, Stop };

// The text of a command: "15", the name of the channel in angle brackets, and the word.
std::string sequencerText(SequencerCommand command);

// A message code as two digits: 1..99, with a leading zero below 10; "00" for anything else.
std::string sequencerCode(std::int32_t code);

// The record that carries a text: 3, the text's length in bytes, and the text in 16-bit characters, all low byte
// first, with no terminator.
std::string sequencerRecord(std::string_view asciiText);

// Takes one whole record off the front of what has arrived and gives its text; nothing while it is not whole. A record
// that is none (another kind, an odd or unlikely length) empties what has arrived and gives "".
std::optional<std::string> takeSequencerRecord(std::string& arrived);

// Name of the local socket on which the sequencing program of that process id listens.
std::string sequencerSocketName(std::int32_t processId);

// Sends a command to it. False where nobody listens there; nothing comes back otherwise.
bool sendToSequencer(std::int32_t processId, SequencerCommand command);
