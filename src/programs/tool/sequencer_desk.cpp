#include "programs/tool/sequencer_desk.h"

#include "util/failure.h"

#include <QCoreApplication>
#include <QLocalSocket>

#include <memory>

namespace {

constexpr const char* kSeqPid = "SeqPid";
constexpr int kReadPatienceMs = 200;  // for the rest of a record whose sender has connected

std::int32_t ownProcess() {
    return static_cast<std::int32_t>(QCoreApplication::applicationPid());
}

std::optional<SequencerCommand> commandOf(const std::string& text) {
    for (const SequencerCommand command : {SequencerCommand::Start, SequencerCommand::Stop}) {
        if (text == sequencerText(command)) return command;
    }
    return std::nullopt;
}

}  // namespace

SequencerDesk::SequencerDesk(SettingsStore& store) : store_(store) {
    const QString name = QString::fromStdString(sequencerSocketName(ownProcess()));
    QLocalServer::removeServer(name);  // of a process that had this number and crashed
    server_.setSocketOptions(QLocalServer::UserAccessOption);
    if (!server_.listen(name)) {
        throw Failure("the requests cannot be listened for: " + server_.errorString().toStdString());
    }
    store_.setValue(kSharedIpcKey, kSeqPid, std::to_string(ownProcess()));
    store_.flush();
}

SequencerDesk::~SequencerDesk() {
    // Another that registered since then keeps its place.
    try {
        store_.flush();
        if (store_.value(kSharedIpcKey, kSeqPid) != std::to_string(ownProcess())) return;
        store_.setValue(kSharedIpcKey, kSeqPid, "0");
        store_.flush();
    } catch (const Failure&) {
        return;  // a store that cannot be read names nobody
    }
}

std::optional<SequencerCommand> SequencerDesk::order(int patienceMs) {
    std::optional<SequencerCommand> last;
    while (server_.waitForNewConnection(last ? 0 : patienceMs)) {
        const std::unique_ptr<QLocalSocket> client(server_.nextPendingConnection());
        std::string arrived;
        std::optional<std::string> text;
        do {
            arrived += client->readAll().toStdString();
            while ((text = takeSequencerRecord(arrived))) {
                if (const std::optional<SequencerCommand> command = commandOf(*text)) last = command;
            }
        } while (client->waitForReadyRead(kReadPatienceMs));
    }
    return last;
}
