#include "link/capture_file.h"
#include "tests/support/folder.h"
#include "util/failure.h"

namespace {

const std::string kFrame = "\x01"
                           "0000007\x04";

}  // namespace

TEST(CaptureFile, ReadsPiecesWithTheirBytes) {
    const Capture capture = parseCapture("zeph-capture 1\r\n0 \\x010000007\\x04\r\n\n# a note\n"
                                         "0 two  blanks \\x5C\\xFF\\x00\n12 ");
    const std::string blanks("two  blanks \\\xFF\0", 15);
    EXPECT_EQ(capture.pieces, (std::vector<CapturePiece>{{0, kFrame}, {0, blanks}, {12, ""}}));
    EXPECT_EQ(capture.cutLine, 0);
}

TEST(CaptureFile, EveryOtherFormIsAFailureThatNamesFileAndLineAsIsAFileThatCannotBeUsed) {
    const Folder folder;
    const std::string path = folder.path("bad.zcap");
    const std::pair<const char*, const char*> rows[] = {
        {"", "line 1: "},
        {"zeph-capture 2\n", "line 1: "},
        {"zeph-capture 1\n\n5\n", "line 3: one blank"},
        {"zeph-capture 1\n 5 x\n", "line 2: a line begins"},
        {"zeph-capture 1\n2147483648 x\n", "line 2: the time is too large"},
        {"zeph-capture 1\n5 x\n4 x\n", "line 3: the time is before"},
        {"zeph-capture 1\n5 \\x0a\n", "line 2: a backslash"},
        {"zeph-capture 1\n5 \xC3\xA9\n", "line 2: a byte"},
    };
    for (const auto& [text, begins] : rows) {
        folder.write("bad.zcap", text);
        EXPECT_THAT([&] { (void)loadCapture(path); },
                    testing::ThrowsMessage<Failure>(testing::StartsWith(path + ", " + begins)));
    }
    EXPECT_THROW(loadCapture(folder.path("none/x.zcap")), Failure);
    EXPECT_THROW(CaptureWriter(folder.path("none/x.zcap")), Failure);
    EXPECT_THROW(CaptureWriter("/dev/full"), Failure);
}

TEST(CaptureFile, ALastLineThatWasCutIsLeftOutAndTold) {
    for (const char* cut : {"1", "12 \\", "12 abc\\x0"}) {
        const std::string text = std::string("zeph-capture 1\n3 a\n") + cut;
        EXPECT_EQ(parseCapture(text).pieces, (std::vector<CapturePiece>{{3, "a"}})) << cut;
        EXPECT_EQ(parseCapture(text).cutLine, 3) << cut;
        EXPECT_THROW((void)parseCapture(text + "\n"), Failure) << cut;
    }
}

TEST(CaptureFile, EveryByteSurvivesWritingAndReading) {
    const Folder folder;
    std::string all;
    for (int code = 0; code < 256; ++code)
        all += static_cast<char>(code);
    CaptureWriter writer(folder.path("all.zcap"));
    writer.piece(0, kFrame);
    EXPECT_EQ(folder.read("all.zcap"), "zeph-capture 1\n0 \\x010000007\\x04\n");  // readable while being written
    writer.piece(7, all);
    EXPECT_THROW(writer.piece(6, "x"), Failure);
    EXPECT_EQ(loadCapture(folder.path("all.zcap")).pieces, (std::vector<CapturePiece>{{0, kFrame}, {7, all}}));
}
