#include "shell/sequencer_control.h"

#include "util/text.h"

void tellSequencer(SequencerCommand command, SettingsStore& store, FailureReport& failures) try {
    store.flush();  // the sequencing program may have started after this one
    const std::int32_t processId = parseLong(store.value(kSharedIpcKey, "SeqPid").value_or("0")).value_or(0);
    if (processId != 0) sendToSequencer(processId, command);
}
ZEPH_GUARD(failures, "frmZephMain", )
