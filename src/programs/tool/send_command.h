// zeph-tool send: plays a capture to a listening simulation in real time, one datagram or write a piece.
#pragma once

#include "programs/tool/options.h"

// Reads file, host, port, tcp, loop and speed (above 0). Returns 0 when all was sent or the user stopped it, 1 where
// the capture cannot be used or the receiver cannot be reached; the message is on standard error then.
int runSend(const ToolOptions& options);
