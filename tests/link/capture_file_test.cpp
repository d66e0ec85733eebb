#include "link/capture_file.h"
#include "util/failure.h"

#include <QTemporaryDir>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <fstream>
#include <sstream>

namespace {

std::string failureOf(std::string_view text) {
    try {
        (void)parseCapture(text);
    } catch (const Failure& failure) {
        return failure.what();
    }
    return "";
}

std::string contentOf(const std::string& path) {
    std::ostringstream text;
    text << std::ifstream(path, std::ios::binary).rdbuf();
    return text.str();
}

}  // namespace

TEST(CaptureFile, ReadsPiecesWithTheirBytes) {
    const Capture capture = parseCapture("zeph-capture 1\r\n"
                                         "0 \\x010000007\\x04\r\n"
                                         "\n"
                                         "# a note\n"
                                         "0 two  blanks \\x5C\\xFF\\x00\n"
                                         "12 ");
    EXPECT_EQ(capture.pieces, (std::vector<CapturePiece>{{0, "\x01"
                                                             "0000007\x04"},
                                                         {0, std::string("two  blanks \\\xFF\0", 15)},
                                                         {12, ""}}));
    EXPECT_EQ(capture.cutLine, 0);
}

TEST(CaptureFile, EveryOtherFormIsAnErrorThatNamesItsLine) {
    const struct {
        const char* text;
        const char* begins;
    } rows[] = {
        {"", "line 1: "},
        {"# note\nzeph-capture 1\n", "line 1: "},
        {"zeph-capture 2\n", "line 1: "},
        {"zeph-capture 1\n\n5\n", "line 3: one blank"},
        {"zeph-capture 1\n5\tx\n", "line 2: one blank"},
        {"zeph-capture 1\n 5 x\n", "line 2: a line begins"},
        {"zeph-capture 1\n-5 x\n", "line 2: a line begins"},
        {"zeph-capture 1\n5.5 x\n", "line 2: one blank"},
        {"zeph-capture 1\n2147483648 x\n", "line 2: the time is too large"},
        {"zeph-capture 1\n5 x\n4 x\n", "line 3: the time is before"},
        {"zeph-capture 1\n5 \\x0a\n", "line 2: a backslash"},
        {"zeph-capture 1\n5 \\n00\n", "line 2: a backslash"},
        {"zeph-capture 1\n5 a\tb\n", "line 2: a byte"},
        {"zeph-capture 1\n5 \xC3\xA9\n", "line 2: a byte"},
        {"zeph-capture 1\n5 \\x0g", "line 2: a backslash"},
        {"zeph-capture 1\n5 a\rb\n", "line 2: a byte"},
    };
    for (const auto& row : rows) {
        EXPECT_THAT(failureOf(row.text), testing::StartsWith(row.begins)) << row.text;
    }
}

TEST(CaptureFile, ALastLineThatWasCutIsLeftOutAndTold) {
    for (const char* cut : {"1", "12", "12 \\", "12 abc\\x", "12 abc\\x0"}) {
        const Capture capture = parseCapture(std::string("zeph-capture 1\n3 a\n") + cut);
        EXPECT_EQ(capture.pieces, (std::vector<CapturePiece>{{3, "a"}})) << cut;
        EXPECT_EQ(capture.cutLine, 3) << cut;
        EXPECT_NE(failureOf(std::string("zeph-capture 1\n3 a\n") + cut + "\n"), "") << cut;
    }
}

TEST(CaptureFile, EveryByteSurvivesWritingAndReading) {
    QTemporaryDir folder;
    const std::string path = folder.filePath("all.zcap").toStdString();
    std::string all;
    for (int code = 0; code < 256; ++code)
        all += static_cast<char>(code);
    {
        CaptureWriter writer(path);
        writer.piece(0, "\x01"
                        "0000007\x04");
        EXPECT_EQ(contentOf(path), "zeph-capture 1\n0 \\x010000007\\x04\n");  // readable while it is still written
        writer.piece(7, all);
        EXPECT_THROW(writer.piece(6, "x"), Failure);
    }
    EXPECT_EQ(loadCapture(path).pieces, (std::vector<CapturePiece>{{0, "\x01"
                                                                       "0000007\x04"},
                                                                   {7, all}}));
}

TEST(CaptureFile, AFileThatCannotBeUsedIsNamed) {
    QTemporaryDir folder;
    const std::string missing = folder.filePath("none/x.zcap").toStdString();
    EXPECT_THROW(loadCapture(missing), Failure);
    EXPECT_THROW(CaptureWriter{missing}, Failure);
    EXPECT_THROW(loadCapture(folder.path().toStdString()), Failure);
    EXPECT_THROW(CaptureWriter("/dev/full"), Failure);
    const std::string bad = folder.filePath("bad.zcap").toStdString();
    std::ofstream(bad) << "zeph-capture 1\nx\n";
    try {
        (void)loadCapture(bad);
        FAIL();
    } catch (const Failure& failure) {
        EXPECT_THAT(failure.what(), testing::StartsWith(bad + ", line 2: "));
    }
}
