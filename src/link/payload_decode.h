// The fast forms of reading light commands: a run of plain 29-character payloads straight into commands. The parser
// tries them first and reads whatever they refuse field by field, so that every form gives the same result.
#pragma once

#include "link/light_command.h"

#include <cstddef>
#include <string_view>

// Decodes payloads from the front of text until one is not an ordinary light command: cmd 00, sub 00 to 03, an address
// that is not all zero, digits in every field and at most one point in the duration. Writes at most `most` commands to
// `out` and returns how many it wrote; those took 29 characters each. Reads within text only.
using DecodeRun = std::size_t (*)(std::string_view text, std::size_t most, ZephChannelCommand* out) noexcept;

// Both halves in one 32-byte register were measured as well and gained nothing.
enum class DecodeForm {
    Plain,  // character by character, on every processor
    Sse41,  // two 16-byte loads a payload
};

// Whether this processor can run the form.
bool hasDecodeForm(DecodeForm form) noexcept;

// The form's procedure. The form must be one that this processor can run.
DecodeRun decodeRunOf(DecodeForm form) noexcept;

// The fastest form of this processor.
DecodeForm fastestDecodeForm() noexcept;
