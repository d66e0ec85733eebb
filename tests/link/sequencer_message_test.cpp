#include "link/sequencer_message.h"

#include <QCoreApplication>
#include <QLocalServer>
#include <QLocalSocket>

#include <thread>

using namespace std::string_literals;

TEST(SequencerMessage, CarriesItsTextIn16BitCharactersWithoutATerminator) {
    EXPECT_EQ(sequencerText(SequencerCommand::Stop), "15<SEQVIS>STOP");
    EXPECT_EQ(sequencerRecord("AB"), "\3\0\0\0\4\0\0\0A\0B\0"s);
    for (const auto& [number, code] : {std::pair{1, "01"}, {10, "10"}, {0, "00"}, {100, "00"}})
        EXPECT_EQ(sequencerCode(number), code);
}

TEST(SequencerMessage, IsTakenOffInPiecesAndOneByOne) {
    const std::string record = sequencerRecord("15<SEQVIS>STOP");
    std::string arrived;
    for (std::size_t i = 0; i + 1 < record.size(); ++i) {
        arrived.push_back(record[i]);
        EXPECT_FALSE(takeSequencerRecord(arrived));
    }
    arrived += record.back() + sequencerRecord("x");
    EXPECT_EQ(takeSequencerRecord(arrived), "15<SEQVIS>STOP");
    EXPECT_EQ(takeSequencerRecord(arrived), "x");
    EXPECT_FALSE(takeSequencerRecord(arrived));

    for (std::string junk : {"\4\0\0\0\2\0\0\0A\0"s, "\3\0\0\0\3\0\0\0A\0B"s, "\3\0\0\0\xFF\xFF\xFF\x7F"s}) {
        EXPECT_EQ(takeSequencerRecord(junk), "");
        EXPECT_TRUE(junk.empty());
    }
}

TEST(SequencerMessage, ReachesWhoeverListensAndSaysSoWhenNobodyDoes) {
    int argc = 0;
    const QCoreApplication application(argc, nullptr);
    const auto pid = static_cast<std::int32_t>(QCoreApplication::applicationPid());
    EXPECT_FALSE(sendToSequencer(pid, SequencerCommand::Start));

    QLocalServer server;
    const QString name = QString::fromStdString(sequencerSocketName(pid));
    QLocalServer::removeServer(name);
    ASSERT_TRUE(server.listen(name));
    std::jthread sender([&] { EXPECT_TRUE(sendToSequencer(pid, SequencerCommand::Start)); });
    ASSERT_TRUE(server.waitForNewConnection(5000));
    QLocalSocket* const client = server.nextPendingConnection();
    std::string arrived;
    std::optional<std::string> text;
    while (!(text = takeSequencerRecord(arrived)) && client->waitForReadyRead(5000))
        arrived += client->readAll().toStdString();
    EXPECT_EQ(text, "15<SEQVIS>START");
}
