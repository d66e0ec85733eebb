// Where a playback on request waits for its orders: registered as the sequencing program of this user, it takes the
// messages of the window's play and stop buttons.
#pragma once

#include "link/sequencer_message.h"
#include "util/settings_store.h"

#include <QLocalServer>

#include <optional>
#include <string>

class SequencerDesk {
public:
    // Registers this process under "SeqPid". Throws Failure where the local socket cannot be opened.
    explicit SequencerDesk(SettingsStore& store);
    ~SequencerDesk();
    SequencerDesk(const SequencerDesk&) = delete;
    SequencerDesk& operator=(const SequencerDesk&) = delete;

    // The last order that has arrived since the call before; nothing where none has. Waits at most so long for one.
    std::optional<SequencerCommand> order(int patienceMs);

private:
    SettingsStore& store_;
    QLocalServer server_;
};
