// The headless companion as its users meet it: arguments in, text, exit status and files out.
#include <QDir>
#include <QFile>
#include <QImage>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QProcess>
#include <QTemporaryDir>

#include <gtest/gtest.h>

namespace {

struct Outcome {
    int status = -1;
    QByteArray out;
    QByteArray err;

    QJsonObject json() const { return QJsonDocument::fromJson(out).object(); }
};

Outcome tool(const QStringList& arguments, const QStringList& without = {},
             const QList<std::pair<QString, QString>>& with = {}) {
    QProcess process;
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    for (const QString& name : without)
        environment.remove(name);
    for (const auto& [name, value] : with)
        environment.insert(name, value);
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

class Tool : public testing::Test {
protected:
    void SetUp() override {
        write("roof.zee", kDisplay);
        // At 10 ms full on; at 30 ms off.
        write("roof.zcap", "zeph-capture 1\n"
                           "10 \\x0100100360000000010020050000.000100100\\x04\n"
                           "30 \\x0100100360000000010020050000.000000000\\x04\n");
    }

    void write(const char* name, const QByteArray& text) {
        QFile file(path(name));
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(text);
    }

    QString path(const QString& name) const { return folder_.filePath(name); }

private:
    QTemporaryDir folder_;
};

}  // namespace

TEST_F(Tool, InfoTellsTheRecords) {
    const Outcome run = tool({"info", path("roof.zee"), "--json"});
    EXPECT_EQ(run.status, 0);
    const QJsonObject info = run.json();
    EXPECT_EQ(info["zephSaveFileVersion"].toString(), "3.0.0");
    EXPECT_TRUE(info["Loaded"].toBool());
    EXPECT_EQ(info["Background"]["WidthPixels"].toInt(), 20);
    const QJsonObject fixture = info["Fixtures"][0].toObject();
    EXPECT_EQ(fixture["Name"].toString(), "Roof");
    EXPECT_EQ(fixture["ZOrder"].toInt(), 4);
    EXPECT_EQ(fixture["Channels"][0]["Multi"][4].toInt(), 16777215);
    EXPECT_EQ(fixture["DrawPoints"][1], (QJsonArray{2, 240, 75}));
}

TEST_F(Tool, InfoTellsWhatCouldNotBeRead) {
    write("bad.zee", "<Other/>");
    const Outcome run = tool({"info", path("bad.zee"), "--json"});
    EXPECT_EQ(run.status, 1);
    EXPECT_FALSE(run.json()["Loaded"].toBool());
    EXPECT_EQ(run.json()["Messages"][0]["Title"].toString(), "Qen Visualizer-Not a valid file");
    EXPECT_TRUE(run.err.startsWith("Qen Visualizer-Not a valid file | Error:  This file  '"));
    EXPECT_TRUE(run.err.endsWith("application. / (003-Invalid Root)\n"));
}

TEST_F(Tool, TableTellsKeysAndPlaces) {
    const Outcome run = tool({"table", path("roof.zee"), "--json"});
    EXPECT_EQ(run.status, 0);
    const QJsonObject table = run.json();
    EXPECT_EQ(table["Entries"][0]["Key"].toInt(), 100'002'005);
    EXPECT_EQ(table["Entries"][0]["Levels"], QJsonArray{4});
    EXPECT_EQ(table["BulbLocations"][0]["Locs"], (QJsonArray{QJsonArray{0, 5, 5}, QJsonArray{0, 15, 5}}));
}

TEST_F(Tool, TraceTellsEveryFrameOfTheVirtualClock) {
    const Outcome run = tool({"trace", path("roof.zee"), "--capture", path("roof.zcap"), "--until", "50", "--json"});
    EXPECT_EQ(run.status, 0);
    EXPECT_EQ(run.out, "{\"t\":9,\"Draws\":[]}\n"
                       "{\"t\":18,\"Draws\":[{\"Level\":4,\"Fixture\":1,\"Channel\":1,\"I\":100}]}\n"
                       "{\"t\":27,\"Draws\":[{\"Level\":4,\"Fixture\":1,\"Channel\":1,\"I\":100}]}\n"
                       "{\"t\":36,\"Draws\":[{\"Level\":4,\"Fixture\":1,\"Channel\":1,\"I\":0}]}\n"
                       "{\"t\":45,\"Draws\":[]}\n");
    const Outcome openGl = tool(
        {"trace", path("roof.zee"), "--capture", path("roof.zcap"), "--until", "15", "--engine", "opengl", "--json"});
    EXPECT_EQ(openGl.out, "{\"t\":15,\"Draws\":[{\"Level\":4,\"Fixture\":1,\"Channel\":1,\"I\":100}]}\n");
}

TEST_F(Tool, RenderDrawsTheFirstFrameAtOrAfterATime) {
    const auto picture = [&](const char* at) {
        const Outcome run =
            tool({"render", path("roof.zee"), "--capture", path("roof.zcap"), "--at", at, "--out", path("roof.png")});
        EXPECT_EQ(run.status, 0) << run.err.constData();
        return QImage(path("roof.png"));
    };
    const QImage lit = picture("10");
    EXPECT_EQ(lit.size(), QSize(20, 10));
    EXPECT_EQ(lit.pixel(4, 4), qRgb(255, 255, 255));  // a square of 2 x 2 around (5, 5)
    EXPECT_EQ(lit.pixel(5, 5), qRgb(255, 255, 255));
    EXPECT_EQ(lit.pixel(6, 5), qRgb(0, 0, 0));
    EXPECT_EQ(lit.pixel(14, 4), qRgb(255, 255, 255));
    EXPECT_EQ(picture("9").pixel(4, 4), qRgb(0, 0, 0));
    EXPECT_EQ(picture("40").pixel(4, 4), qRgb(0, 0, 0));

    const Outcome film = tool({"render", path("roof.zee"), "--capture", path("roof.zcap"), "--from", "0", "--to", "40",
                               "--fps", "100", "--out", path("film/")});
    EXPECT_EQ(film.status, 0) << film.err.constData();
    EXPECT_EQ(QDir(path("film")).entryList({"frame*.png"}).size(), 5);
    EXPECT_EQ(QImage(path("film/frame00002.png")).pixel(4, 4), qRgb(255, 255, 255));
}

// Without a screen: no variable that leads to one is handed on.
TEST_F(Tool, RenderDrawsThroughOpenGLWithoutAScreen) {
    const QStringList render{"render", path("roof.zee"), "--capture", path("roof.zcap"), "--engine",
                             "opengl", "--at",           "15",        "--out",           path("gl.png")};
    const Outcome run = tool(render, {"DISPLAY", "WAYLAND_DISPLAY"});
    ASSERT_EQ(run.status, 0) << run.err.constData();
    const QImage lit(path("gl.png"));
    EXPECT_EQ(lit.size(), QSize(20, 10));
    EXPECT_EQ(lit.pixel(4, 4), qRgb(255, 255, 255));
    EXPECT_EQ(lit.pixel(5, 5), qRgb(255, 255, 255));
    EXPECT_EQ(lit.pixel(6, 5), qRgb(0, 0, 0));
    EXPECT_EQ(lit.pixel(14, 4), qRgb(255, 255, 255));

    // Frames at 15, 30 and 45 ms for pictures at 0, 20 and 40; the command that ends at 30 is dark in the last two.
    const QStringList film{
        "render", path("roof.zee"), "--capture", path("roof.zcap"), "--engine", "opengl", "--from",
        "0",      "--to",           "40",        "--fps",           "50",       "--out",  path("gl/")};
    ASSERT_EQ(tool(film, {"DISPLAY", "WAYLAND_DISPLAY"}).status, 0);
    EXPECT_EQ(QDir(path("gl")).entryList({"frame*.png"}).size(), 3);
    EXPECT_EQ(QImage(path("gl/frame00001.png")).pixel(4, 4), qRgb(255, 255, 255));
    EXPECT_EQ(QImage(path("gl/frame00003.png")).pixel(4, 4), qRgb(0, 0, 0));
}

TEST_F(Tool, TellsThatThereIsNoOpenGL) {
    QTemporaryDir nothing;
    const QStringList render{"render", path("roof.zee"), "--capture", path("roof.zcap"), "--engine",
                             "opengl", "--at",           "15",        "--out",           path("gl.png")};
    // The loader of drivers is told to look where there are none.
    const Outcome run = tool(render, {}, {{"__EGL_VENDOR_LIBRARY_DIRS", nothing.path()}});
    EXPECT_EQ(run.status, 1);
    EXPECT_TRUE(run.err.startsWith("zeph-tool: No OpenGL")) << run.err.constData();
    EXPECT_FALSE(QFile::exists(path("gl.png")));
}

TEST_F(Tool, ExitsWithOneForBadInputAndTwoForWrongUsage) {
    EXPECT_EQ(tool({"trace", path("roof.zee"), "--capture", path("none.zcap"), "--until", "9"}).status, 1);
    write("bad.zcap", "zeph-capture 1\n5 a\n4 b\n");
    const Outcome bad = tool({"trace", path("roof.zee"), "--capture", path("bad.zcap"), "--until", "9"});
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
    write("old.zee", QByteArray(kDisplay).replace("3.0.0", "2.1.0"));
    const auto read = [&](const char* name) {
        QFile file(path(name));
        return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray("not there");
    };
    EXPECT_EQ(tool({"convert", path("old.zee"), path("new.zee")}).status, 0);
    const QJsonObject info = tool({"info", path("new.zee"), "--json"}).json();
    EXPECT_EQ(info["zephSaveFileVersion"].toString(), "3.0.0");
    EXPECT_EQ(info["Fixtures"][0]["Name"].toString(), "Roof");
    EXPECT_TRUE(read("new.zee").contains(" Chksum=\""));

    const Outcome refused = tool({"convert", path("old.zee"), path("old.zee")});
    EXPECT_EQ(refused.status, 1);
    EXPECT_TRUE(refused.err.endsWith("old.zee exists; --force replaces it\n")) << refused.err.constData();
    EXPECT_TRUE(read("old.zee").contains("2.1.0"));
    EXPECT_EQ(tool({"convert", path("old.zee"), path("old.zee"), "--force"}).status, 0);
    EXPECT_TRUE(read("old.zee").contains("\"3.0.0\""));

    write("bad.zee", QByteArray(kDisplay).replace("BulbSize", "BulbSise"));
    EXPECT_EQ(tool({"convert", path("bad.zee"), path("half.zee")}).status, 1);
    EXPECT_EQ(read("half.zee"), "not there");
    EXPECT_EQ(tool({"convert", path("new.zee"), path("no/folder.zee")}).status, 1);
}

TEST_F(Tool, DemoShowAddressesTheDisplay) {
    EXPECT_EQ(tool({"demo-show", path("roof.zee"), "--out", path("show.zcap"), "--seconds", "5"}).status, 0);
    const Outcome run = tool({"trace", path("roof.zee"), "--capture", path("show.zcap"), "--until", "5000"});
    EXPECT_TRUE(run.out.contains(" L4 F1 C1 I100"));
}
