// The parser of the channel stream: cuts complete frames from the receive buffer and turns their payloads into light
// commands and level dumps. It never sees a socket. docs/stream.md tells the format.
#pragma once

#include "link/level_dump.h"
#include "link/light_command.h"
#include "link/packet_parms.h"
#include "link/payload_decode.h"
#include "link/stream_buffer.h"
#include "util/failure.h"

#include <cstdint>

// What the receiver keeps of the stream. One for the program.
struct ChannelStream {
    StreamBuffer ZephStackBuffer;          // bytes that no frame has been cut from yet
    LevelDumps Dumps;                      // dumps that wait for the next drawn frame
    ZephLightTiming LastTiming;            // of the light command read last; never reset
    std::uint32_t ZephPayloadSerial = 0;   // payloads begun; zeroed when a simulation ends; for diagnosis only
    std::uint32_t ZephReceptionCount = 0;  // socket events since the last render cycle; for diagnosis only
};

// What the parser reads and does not change. decodeRun: any form, all give the same result.
struct ParserSetup {
    ZephPacketParms PacketParms{};
    DecodeRun decodeRun = decodeRunOf(fastestDecodeForm());
};

// Works off every complete frame of the buffer; called at the head of each render cycle. Outside simulation the buffer
// is emptied unread. A frame that is not well-formed is dropped without a word, from the first payload that cannot be
// read on, and ends the call: the frame behind it waits for the next one.
void ZephProcessPayloads(bool simulating, const ParserSetup& setup, CommandSink& sink, FailureReport& failures,
                         ChannelStream& stream);
