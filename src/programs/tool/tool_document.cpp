#include "programs/tool/tool_document.h"

#include "util/text.h"

#include <QFileInfo>

void PrintedFailures::ErrReport(std::string_view description, std::string_view procedure, int line) {
    const std::string text =
        std::string(procedure) + "-" + std::to_string(line) + " (" + std::string(description) + ")";
    std::fprintf(stderr, "%s\n", onOneLine(text).c_str());
}

std::unique_ptr<ToolDocument> loadToolDocument(const std::string& file) {
    auto document = std::make_unique<ToolDocument>();
    const std::string full = QFileInfo(QString::fromLocal8Bit(file.c_str())).absoluteFilePath().toStdString();
    ZephSimulation& simulation = *document->simulation;
    simulation.FilePath = ZephPathFromFullPath(full);
    simulation.FileName = ZephNameFromFullPath(full);
    // As the window does before every load, so that a file that cannot be read leaves an empty document.
    ZephGlobalReset(false, simulation, document->watcher);
    const EditorFileContext context{document->settings, document->paths, document->host, document->failures,
                                    document->watcher};
    document->loaded = ZephLoadVisualizerXML(true, context, simulation);
    return document;
}

CompiledDocument compileToolDocument(const std::string& file) {
    CompiledDocument compiled;
    compiled.document = loadToolDocument(file);
    ToolDocument& document = *compiled.document;
    if (document.loaded) {
        ZephBuildRenderTable({document.settings, document.host, document.failures, *document.simulation,
                              *compiled.states, compiled.tables});
    }
    return compiled;
}
