// Opening and saving the limit document, beside what a reader could take instead: the hash alone, a stream reader of
// XML that only looks at each attribute, a parser that only builds the tree.
#include "bench/bench_report.h"
#include "model/checksum.h"
#include "model/editor_elements.h"
#include "model/editor_writer.h"
#include "tests/support/limit_document.h"
#include "tests/support/recording_host.h"
#include "util/whole_file.h"

#include <QDir>
#include <QTemporaryDir>
#include <QXmlStreamReader>

#include <cstdio>
#include <memory>
#include <pugixml.hpp>

namespace {

constexpr int kRuns = 9;

std::string ratioText(double value) {
    char text[32];
    std::snprintf(text, sizeof text, "%.2f x", value);
    return text;
}

qint64 readAttributesOnly(const QByteArray& text) {
    QXmlStreamReader reader(text);
    qint64 length = 0;
    while (!reader.atEnd()) {
        if (reader.readNext() != QXmlStreamReader::StartElement) continue;
        for (const QXmlStreamAttribute& attribute : reader.attributes())
            length += attribute.value().size();
    }
    return length;
}

// A folder in memory where there is one: what a disk's flush takes is not the program's.
QString quickFolder() {
    return QFileInfo::exists("/dev/shm") ? QStringLiteral("/dev/shm/zeph-XXXXXX") : QDir::tempPath() + "/zeph-XXXXXX";
}

}  // namespace

void benchLoad(BenchReport& report) {
    QTemporaryDir folder(quickFolder());
    const ZephPathService paths(folder.path().toStdString());
    const ZephSettings settings;
    RecordingHost host;
    CollectingFailures failures;
    NoWatcher watcher;
    const EditorFileContext context{settings, paths, host, failures, watcher};

    const auto simulation = std::make_unique<ZephSimulation>();
    buildLimitDocument(*simulation);
    simulation->FilePath = folder.path().toStdString() + "/";
    simulation->FileName = "limit.zee";
    const std::string plain = editorText(*simulation, paths, "21.11.26 10:00:00");
    const QByteArray plainBytes = QByteArray::fromStdString(plain);
    const QString wide = QString::fromUtf8(plainBytes);
    const QByteArrayView wideBytes(reinterpret_cast<const char*>(wide.utf16()), wide.size() * 2);

    const double build = medianMicroseconds(kRuns, [&] { keepResult(editorText(*simulation, paths, "now")); });
    const auto loaded = std::make_unique<ZephSimulation>();
    const auto reset = [&] {
        loaded->FilePath = simulation->FilePath;
        ZephGlobalReset(false, *loaded, watcher);
    };
    bool good = true;
    const auto loadFile = [&] { good = ZephLoadVisualizerXML(true, context, *loaded) && good; };
    loaded->FileName = "limit.zee";
    // In turns, so that what else the machine does meanwhile falls on both alike.
    std::vector<double> md5Times, loadTimes, saveTimes, ratios, saveRatios;
    for (int run = 0; run < kRuns; ++run) {
        md5Times.push_back(
            microsecondsOf([&] { keepResult(QCryptographicHash::hash(wideBytes, QCryptographicHash::Md5)); }));
        saveTimes.push_back(microsecondsOf([&] { ZephSaveVisualizerXML("21.11.26 10:00:00", context, *simulation); }));
        saveRatios.push_back(saveTimes.back() / md5Times.back());
        reset();
        loadTimes.push_back(microsecondsOf(loadFile));
        ratios.push_back(loadTimes.back() / md5Times.back());
    }
    const double loadRatio = medianOf(ratios);
    good = good && !loaded->ChecksumMismatch && loaded->Fixtures == simulation->Fixtures;
    loaded->FileName = "plain.zee";
    good = good && replaceWholeFile(simulation->FilePath + "plain.zee", plain);
    const double withoutChecksum = medianMicroseconds(kRuns, reset, loadFile);
    const double resetOnly = medianMicroseconds(kRuns, loadFile, [&] { ZephGlobalReset(false, *loaded, watcher); });
    const double general = medianMicroseconds(
        3, reset, [&] { good = loadEditorText(plain, TextReading::GeneralOnly, true, context, *loaded) && good; });
    const double stream = medianMicroseconds(3, [&] { keepResult(readAttributesOnly(plainBytes)); });
    const double tree = medianMicroseconds(3, [&] {
        pugi::xml_document document;
        keepResult(document.load_buffer(plain.data(), plain.size()).status);
    });

    const std::string withGroup = "Limit document (1024 x 256 points, 16,384 channels), checksum verified";
    report.row(withGroup, "MD5 alone over the same text", medianOf(md5Times));
    report.row(withGroup, "load the file, checksum verified", medianOf(loadTimes));
    report.row(withGroup, "save the file, checksum included", medianOf(saveTimes));
    const std::string group = "Limit document without a checksum";
    report.row(group, "load the file", withoutChecksum);
    report.row(group, "load, general form only", general);
    report.row(group, "pugixml, tree only", tree);
    report.row(group, "QXmlStreamReader, attributes only", stream);
    report.row(group, "build the text", build);
    report.row(group, "empty the loaded document", resetOnly);
    report.goal("load", ratioText(loadRatio), "at most 1.3 x MD5 alone", good && loadRatio <= 1.3);
    report.goal("load-plain", ratioText(stream / withoutChecksum), "at least 8 x faster than QXmlStreamReader",
                good && stream >= 8 * withoutChecksum);
    const double saveRatio = medianOf(saveRatios);
    report.goal("save", ratioText(saveRatio), "at most 1.5 x MD5 alone, flush not counted", good && saveRatio <= 1.5);
}
