// The headless companion as its users meet it: arguments in, text, exit status and files out.
#include "tests/support/folder.h"

#include <QImage>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QProcess>

namespace {

struct Outcome {
    int status = -1;
    QByteArray out;
    QByteArray err;

    QJsonObject json() const { return QJsonDocument::fromJson(out).object(); }
};

Outcome tool(const QStringList& arguments,
             const QProcessEnvironment& environment = QProcessEnvironment::systemEnvironment()) {
    QProcess process;
    process.setProcessEnvironment(environment);
    process.start(ZEPH_TOOL, arguments);
    EXPECT_TRUE(process.waitForFinished(60'000));
    return {process.exitCode(), process.readAllStandardOutput(), process.readAllStandardError()};
}

// One light string on the first circuit of unit 2, white on black.
constexpr const char* kDisplay = R"(<?xml version='1.0' encoding='UTF-8'?>
<Zeph zephSaveFileVersion="3.0.0" CreatedAt="">
<Background BackgroundType="0" PicIntensity="0" EditorWidthTwips="300" EditorHeightTwips="150"/>
<DrawObjects>
<DrawObject ID="1" Name="Roof" BulbSize="1" BulbSpacing="8" Comment="" BulbShape="3" ZOrder="4" AssignedItem="0"
 Locked="False" Fixture_Type="1" Channel_Type="1" Max_Opacity="50">
<AssignedChannels><Channel ID="1" Name="c" DeviceType="1" Network="0" Controller="2" Channel="5" Color="16777215"/></AssignedChannels>
<DrawPoints><DrawPoint ID="1" Type="6" X="75" Y="75"/><DrawPoint ID="2" Type="2" X="240" Y="75"/></DrawPoints>
</DrawObject>
</DrawObjects>
</Zeph>)";

struct Tool : testing::Test {
    void SetUp() override {
        folder.write("roof.zee", kDisplay);
        // At 10 ms full on; at 30 ms off.
        folder.write("roof.zcap", "zeph-capture 1\n"
                                  "10 \\x0100100360000000010020050000.000100100\\x04\n"
                                  "30 \\x0100100360000000010020050000.000000000\\x04\n");
    }
    QString path(const char* name) const { return folder.qPath(name); }
    // A command on the roof, with its capture where it takes one.
    QStringList roof(const char* command, const QStringList& rest = {}) const {
        const bool plays = QString(command) == "trace" || QString(command) == "render";
        return QStringList{command, path("roof.zee")} +
               (plays ? QStringList{"--capture", path("roof.zcap")} : QStringList()) + rest;
    }
    // Whether a pixel is white; else it has to be black.
    bool lit(const char* picture, int x = 4, int y = 4) const {
        const QRgb pixel = QImage(path(picture)).pixel(x, y);
        EXPECT_TRUE(pixel == qRgb(255, 255, 255) || pixel == qRgb(0, 0, 0)) << pixel;
        return pixel == qRgb(255, 255, 255);
    }

    Folder folder;
};

}  // namespace

TEST_F(Tool, InfoAndTableTellTheRecordsAndWhatCouldNotBeRead) {
    const QJsonObject info = tool(roof("info", {"--json"})).json();
    EXPECT_EQ(info["zephSaveFileVersion"].toString(), "3.0.0");
    EXPECT_TRUE(info["Loaded"].toBool());
    EXPECT_EQ(info["Background"]["WidthPixels"].toInt(), 20);
    const QJsonObject fixture = info["Fixtures"][0].toObject();
    EXPECT_EQ(fixture["Channels"][0]["Multi"][4].toInt(), 16777215);
    EXPECT_EQ(fixture["DrawPoints"][1], (QJsonArray{2, 240, 75}));
    const QJsonObject table = tool(roof("table", {"--json"})).json();
    EXPECT_EQ(table["Entries"][0]["Key"].toInt(), 100'002'005);
    EXPECT_EQ(table["Entries"][0]["Levels"], QJsonArray{4});
    EXPECT_EQ(table["BulbLocations"][0]["Locs"], (QJsonArray{QJsonArray{0, 5, 5}, QJsonArray{0, 15, 5}}));

    folder.write("bad.zee", "<Other/>");
    const Outcome bad = tool({"info", path("bad.zee"), "--json"});
    EXPECT_EQ(bad.status, 1);
    EXPECT_FALSE(bad.json()["Loaded"].toBool());
    EXPECT_TRUE(bad.err.startsWith(bad.json()["Messages"][0]["Title"].toString().toUtf8() + " | Error:  This file  '"));
    EXPECT_TRUE(bad.err.endsWith("application. / (003-Invalid Root)\n"));
}

TEST_F(Tool, TraceTellsEveryFrameOfTheVirtualClock) {
    const Outcome run = tool(roof("trace", {"--until", "50", "--json"}));
    EXPECT_EQ(run.status, 0);
    EXPECT_EQ(run.out, "{\"t\":9,\"Draws\":[]}\n"
                       "{\"t\":18,\"Draws\":[{\"Level\":4,\"Fixture\":1,\"Channel\":1,\"I\":100}]}\n"
                       "{\"t\":27,\"Draws\":[{\"Level\":4,\"Fixture\":1,\"Channel\":1,\"I\":100}]}\n"
                       "{\"t\":36,\"Draws\":[{\"Level\":4,\"Fixture\":1,\"Channel\":1,\"I\":0}]}\n"
                       "{\"t\":45,\"Draws\":[]}\n");
    EXPECT_EQ(tool(roof("trace", {"--until", "15", "--engine", "opengl", "--json"})).out,
              "{\"t\":15,\"Draws\":[{\"Level\":4,\"Fixture\":1,\"Channel\":1,\"I\":100}]}\n");
}

// OpenGL without a screen: no variable that leads to one is handed on.
TEST_F(Tool, RenderDrawsTheFirstFrameAtOrAfterATime) {
    QProcessEnvironment noScreen = QProcessEnvironment::systemEnvironment();
    noScreen.remove("DISPLAY");
    noScreen.remove("WAYLAND_DISPLAY");
    for (const char* engine : {"standard", "opengl"}) {
        const auto drawn = [&](const QStringList& rest) {
            const Outcome run = tool(roof("render", QStringList{"--engine", engine} + rest), noScreen);
            EXPECT_EQ(run.status, 0) << run.err.constData();
        };
        drawn({"--at", "15", "--out", path("lit.png")});
        EXPECT_EQ(QImage(path("lit.png")).size(), QSize(20, 10));
        for (const auto& [x, y, on] : {std::tuple{4, 4, true}, {5, 5, true}, {6, 5, false}, {14, 4, true}})
            EXPECT_EQ(lit("lit.png", x, y), on) << engine << x;  // squares of 2 x 2 around (5, 5) and (15, 5)
        drawn({"--at", "9", "--out", path("early.png")});
        EXPECT_EQ(lit("early.png"), QString(engine) == "opengl") << "its first frame comes at 15";

        // Frames at 9, 18, 27 ... or at 15, 30, 45; the command that ends at 30 is dark from 36, or 30, on.
        drawn({"--from", "0", "--to", "40", "--fps", "50", "--out", path("film/")});
        EXPECT_EQ(QDir(path("film")).entryList({"frame*.png"}).size(), 3);
        EXPECT_EQ(lit("film/frame00002.png"), QString(engine) != "opengl");
        EXPECT_FALSE(lit("film/frame00003.png"));
    }
}

TEST_F(Tool, TellsThatThereIsNoOpenGL) {
    // The loader of drivers is told to look where there are none.
    QProcessEnvironment noDriver = QProcessEnvironment::systemEnvironment();
    noDriver.insert("__EGL_VENDOR_LIBRARY_DIRS", path("none"));
    const Outcome run = tool(roof("render", {"--engine", "opengl", "--at", "15", "--out", path("gl.png")}), noDriver);
    EXPECT_EQ(run.status, 1);
    EXPECT_TRUE(run.err.startsWith("zeph-tool: No OpenGL")) << run.err.constData();
    EXPECT_FALSE(QFile::exists(path("gl.png")));
}

TEST_F(Tool, ExitsWithOneForBadInputAndTwoForWrongUsage) {
    folder.write("roof.zcap", "zeph-capture 1\n5 a\n4 b\n");
    const Outcome bad = tool(roof("trace", {"--until", "9"}));
    EXPECT_EQ(bad.status, 1);
    EXPECT_TRUE(bad.err.contains("line 3")) << bad.err.constData();
    const Outcome usage = tool({"trace", path("roof.zee")});
    EXPECT_EQ(usage.status, 2);
    EXPECT_TRUE(usage.err.contains("usage: zeph-tool trace"));
    EXPECT_EQ(tool({"--help"}).status, 0);
    QProcess full;
    full.setStandardOutputFile("/dev/full");
    full.start(ZEPH_TOOL, {"info", path("roof.zee"), "--json"});
    ASSERT_TRUE(full.waitForFinished());
    EXPECT_EQ(full.exitCode(), 1);
    EXPECT_TRUE(full.readAllStandardError().contains("could not be written"));
}

TEST_F(Tool, ConvertWritesThePresentVersionAndSparesWhatIsThere) {
    folder.write("old.zee", QByteArray(kDisplay).replace("3.0.0", "2.1.0"));
    const Outcome refused = tool({"convert", path("old.zee"), path("old.zee")});
    EXPECT_EQ(refused.status, 1);
    EXPECT_TRUE(refused.err.endsWith("old.zee exists; --force replaces it\n")) << refused.err.constData();
    EXPECT_THAT(folder.read("old.zee"), testing::HasSubstr("2.1.0"));
    EXPECT_EQ(tool({"convert", path("old.zee"), path("new.zee")}).status, 0);
    EXPECT_EQ(tool({"convert", path("old.zee"), path("old.zee"), "--force"}).status, 0);
    for (const char* name : {"new.zee", "old.zee"})
        EXPECT_THAT(folder.read(name), testing::ContainsRegex("\"3.0.0\".* Chksum=\".*\"Roof\""));

    folder.write("bad.zee", QByteArray(kDisplay).replace("BulbSize", "BulbSise"));
    EXPECT_EQ(tool({"convert", path("bad.zee"), path("half.zee")}).status, 1);
    EXPECT_EQ(folder.read("half.zee"), "not there");
    EXPECT_EQ(tool({"convert", path("new.zee"), path("no/folder.zee")}).status, 1);
}

TEST_F(Tool, DemoShowAddressesTheDisplay) {
    EXPECT_EQ(tool(roof("demo-show", {"--out", path("roof.zcap"), "--seconds", "5"})).status, 0);
    EXPECT_TRUE(tool(roof("trace", {"--until", "5000"})).out.contains(" L4 F1 C1 I100"));
}
