// The two buttons of a simulation that tell the sequencing program to start and stop.
#pragma once

#include "link/sequencer_message.h"
#include "util/failure.h"
#include "util/settings_store.h"

// Sends the command to the program that "SeqPid" of the shared key names; nothing happens where it names none or where
// that one no longer listens.
void tellSequencer(SequencerCommand command, SettingsStore& store, FailureReport& failures);
