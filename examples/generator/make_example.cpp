#include "display.h"
#include "model/editor_writer.h"
#include "paint_picture.h"
#include "util/message_host.h"

#include <QFile>
#include <QGuiApplication>

#include <cstdio>

namespace {

class PrintedFailures : public FailureReport {
public:
    void ErrReport(std::string_view description, std::string_view procedure, int line) override {
        std::fprintf(stderr, "%.*s, line %d: %.*s\n", static_cast<int>(procedure.size()), procedure.data(), line,
                     static_cast<int>(description.size()), description.data());
    }
};

bool writeExample(const std::string& folder) {
    if (!paintPicture().save(QString::fromStdString(folder + "/house.png"))) {
        std::fprintf(stderr, "house.png cannot be written to %s\n", folder.c_str());
        return false;
    }
    const auto display = std::make_unique<ZephSimulation>();
    buildDisplay(*display);
    display->FilePath = folder + "/";
    display->FileName = "house.zee";
    const ZephSettings settings;
    const ZephPathService paths(folder);
    MessageHost host(stderr);
    PrintedFailures failures;
    NoWatcher watcher;
    // A fixed date: the example stays the same file until its display changes.
    return ZephSaveVisualizerXML("12/24/2025 6:00:00 PM", {settings, paths, host, failures, watcher}, *display);
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 2) {
        std::fprintf(stderr, "usage: zeph-make-example FOLDER\n");
        return 2;
    }
    const QGuiApplication application(argc, argv);  // QPainter needs its fonts and colours
    return writeExample(QFile::decodeName(argv[1]).toStdString()) ? 0 : 1;
}
