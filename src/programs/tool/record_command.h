// zeph-tool record: writes what arrives on a port to a capture file, one line a datagram or read.
#pragma once

#include "programs/tool/options.h"

// Reads out, port, address, tcp and seconds (none = until the user stops it). Returns 0 when the recording ended, 1
// where the port or the file cannot be used; the message is on standard error then.
int runRecord(const ToolOptions& options);
