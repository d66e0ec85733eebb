// The quick form of reading must give exactly what the general form gives, whatever is done to a file.
#include "display.h"
#include "model/editor_writer.h"
#include "model/source_text.h"
#include "model/xml_scanner.h"
#include "tests/support/loading.h"
#include "util/random_source.h"

namespace {

// A display small enough that a change is likely to hit something, with one of everything.
std::string smallDisplay(LoadBench& bench) {
    const auto full = std::make_unique<ZephSimulation>();
    buildDisplay(*full);
    ZephSimulation& simulation = *bench.simulation;
    simulation.Background = {2, bench.folder.path("a&b.png"), 100, 15000, 15000};
    simulation.PropCount = 1;
    simulation.Props[1] = full->Props[1];
    simulation.Props[1].Name = "Pixels & \"stars\" <garden>";
    for (std::int32_t type = kFixtureStrings; type <= kFixtureDmxPixels; ++type) {
        ZephFixture& fixture = simulation.Fixtures[++simulation.FixtureCount];
        fixture = *std::ranges::find(full->Fixtures, type, &ZephFixture::Fixture_Type);
        fixture.AssignedItem = type == kFixtureStrings ? 1 : 0;
        fixture.PointCount = std::min(fixture.PointCount, 3);
        fixture.ChannelCount = std::min(fixture.ChannelCount, 2);
    }
    std::string text = editorText(simulation, bench.paths, "today");
    AddHash(false, text);
    return text;
}

// One of the things that happen to files, or that people do to them.
void harm(std::string& text, RandomSource& random) {
    static const char kPieces[] =
        " |\t|\r\n|<!-- x -->|<?x y?>|<Level ID=\"3\"/>| ID=\"1\"| LED=\"True\"|<|>|/|\"|'|&amp;|&|&#65;|&bad;|"
        "<![CDATA[]]>|<A/>|</A>|-1|0|257|2147483648|+|True|x|ID=\"2\"|\xC3\xA4|\xFF|2.1.0|=|</DrawPoints>|Kesh";
    static const QList<QByteArray> pieces = QByteArray(kPieces).split('|');
    const auto size = static_cast<std::int32_t>(text.size());
    const auto at = static_cast<std::size_t>(ZephReturnRandomNumber(0, size - 1, random));
    const auto length = static_cast<std::size_t>(ZephReturnRandomNumber(1, 12, random));
    const std::string piece =
        pieces[ZephReturnRandomNumber(0, static_cast<std::int32_t>(pieces.size()) - 1, random)].toStdString();
    const std::size_t quote = text.find("=\"", at);
    const std::size_t blank = text.find(' ', at);
    const std::int32_t kind = ZephReturnRandomNumber(0, 7, random);
    if (kind == 0) text.erase(at, length);
    if (kind == 1) text.replace(at, piece.size(), piece);
    if (kind == 2) text.insert(at, text.substr(at, 5 * length));
    if (kind == 3) text.at(at) = static_cast<char>(ZephReturnRandomNumber(0, 255, random));
    // A value rather than any place: between two quotes.
    if (kind == 4 && quote != std::string::npos) text.replace(quote + 2, text.find('"', quote + 2) - quote - 2, piece);
    // A whole attribute.
    if (kind == 5 && blank != std::string::npos) text.erase(blank, text.find(' ', blank + 1) - blank);
    if (kind == 6) text.insert(at, piece);
    if (kind == 7) text.resize(at);
}

struct Outcome {
    LoadBench bench;
    bool result = false;

    Outcome(const std::string& text, TextReading reading) {
        bench.simulation->FilePath = "";
        bench.paths = ZephPathService("/base");  // the same for both, since it shows in the picture's path
        result = bench.read(text, reading);
    }
};

}  // namespace

TEST(TwoForms, AgreeOnEveryHarmedFile) {
    LoadBench source;
    const std::string whole = smallDisplay(source);
    SeededRandom random(20);
    int readQuickly = 0;
    constexpr int kFiles = 500;
    for (int file = 0; file < kFiles && !HasFailure(); ++file) {
        std::string text = whole;
        for (int harms = ZephReturnRandomNumber(1, 2, random); harms > 0; --harms)
            harm(text, random);
        SCOPED_TRACE(text);
        const Outcome quick(text, TextReading::QuickThenGeneral);
        const Outcome general(text, TextReading::GeneralOnly);
        EXPECT_EQ(quick.result, general.result);
        EXPECT_TRUE(*quick.bench.simulation == *general.bench.simulation);
        EXPECT_EQ(quick.bench.host.boxTexts(), general.bench.host.boxTexts());
        EXPECT_EQ(quick.bench.failures.reports, general.bench.failures.reports);
        EXPECT_EQ(quick.bench.watcher.selections, general.bench.watcher.selections);
        if (XmlScanner::isUsual(SourceText(text).view())) ++readQuickly;
    }
    // Were nearly all of them unusual, the comparison would compare the general form with itself.
    EXPECT_GT(readQuickly, kFiles / 6);
    EXPECT_LT(readQuickly, kFiles * 4 / 5);
}

TEST(TwoForms, TheQuickFormTakesWhatTheProgramWrites) {
    LoadBench bench;
    const std::string text = smallDisplay(bench);
    EXPECT_TRUE(bench.read(text, TextReading::QuickOnly));
    EXPECT_FALSE(bench.read("<Zeph zephSaveFileVersion='3.0.0'></Zeph>", TextReading::QuickOnly));
    EXPECT_EQ(bench.simulation->FixtureCount, 5);
}
