#include "link/sequencer_message.h"

#include <QLocalSocket>

namespace {

constexpr std::int32_t kRecordKind = 3;
constexpr std::int32_t kSequencerCode = 15;
constexpr std::size_t kHeaderBytes = 8;
constexpr std::uint32_t kMostTextBytes = 4096;  // far above any command; what claims more is not from the family
constexpr int kPatienceMs = 300;                // a click must not hang on a program that does not answer

void appendLong(std::uint32_t value, std::string& record) {
    for (int shift = 0; shift < 32; shift += 8)
        record.push_back(static_cast<char>(value >> shift & 0xFF));
}

std::uint32_t longAt(const std::string& record, std::size_t at) {
    std::uint32_t value = 0;
    for (std::size_t byte = 0; byte < 4; ++byte) {
        value |= static_cast<std::uint32_t>(static_cast<unsigned char>(record[at + byte])) << (8 * byte);
    }
    return value;
}

}  // namespace

std::string sequencerCode(std::int32_t code) {
    if (code < 1 || code > 99) return "00";
    return (code < 10 ? "0" : "") + std::to_string(code);
}

std::string sequencerText(SequencerCommand command) {
    return sequencerCode(kSequencerCode) + "<SEQVIS>" + (command == SequencerCommand::Start ? "START" : "STOP");
}

std::string sequencerRecord(std::string_view asciiText) {
    std::string record;
    appendLong(kRecordKind, record);
    appendLong(static_cast<std::uint32_t>(asciiText.size() * 2), record);
    for (const char letter : asciiText) {
        record.push_back(letter);
        record.push_back('\0');
    }
    return record;
}

std::optional<std::string> takeSequencerRecord(std::string& arrived) {
    if (arrived.size() < kHeaderBytes) return std::nullopt;
    const std::uint32_t bytes = longAt(arrived, 4);
    if (longAt(arrived, 0) != kRecordKind || bytes % 2 != 0 || bytes > kMostTextBytes) {
        arrived.clear();
        return "";
    }
    if (arrived.size() < kHeaderBytes + bytes) return std::nullopt;
    QString text;
    for (std::size_t at = kHeaderBytes; at < kHeaderBytes + bytes; at += 2) {
        const unsigned low = static_cast<unsigned char>(arrived[at]);
        const unsigned high = static_cast<unsigned char>(arrived[at + 1]);
        text.append(QChar(static_cast<char16_t>(low | high << 8)));
    }
    arrived.erase(0, kHeaderBytes + bytes);
    return text.toStdString();
}

std::string sequencerSocketName(std::int32_t processId) {
    return "zeph-sequencer-" + std::to_string(processId);
}

bool sendToSequencer(std::int32_t processId, SequencerCommand command) {
    QLocalSocket socket;
    socket.connectToServer(QString::fromStdString(sequencerSocketName(processId)), QIODevice::WriteOnly);
    if (!socket.waitForConnected(kPatienceMs)) return false;
    const std::string record = sequencerRecord(sequencerText(command));
    socket.write(record.data(), static_cast<qint64>(record.size()));
    const bool written = socket.waitForBytesWritten(kPatienceMs);
    socket.disconnectFromServer();
    return written;
}
