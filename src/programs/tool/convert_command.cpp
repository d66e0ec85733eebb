#include "programs/tool/convert_command.h"

#include "model/editor_elements.h"
#include "model/editor_writer.h"
#include "programs/tool/tool_document.h"
#include "util/text.h"

#include <QFileInfo>

int runConvert(const ToolOptions& options) {
    const QFileInfo target(QString::fromLocal8Bit(options.secondFile.c_str()));
    // A link that leads nowhere counts as well: somebody put it there.
    if ((target.exists() || target.isSymLink()) && !options.force) {
        std::fprintf(stderr, "zeph-tool: %s exists; --force replaces it\n", options.secondFile.c_str());
        return 1;
    }
    const std::unique_ptr<ToolDocument> document = loadToolDocument(options.file);
    // A display that was read only in part would be written only in part.
    if (!document->loaded) return 1;
    ZephSimulation& simulation = *document->simulation;
    const std::string full = target.absoluteFilePath().toStdString();
    simulation.FilePath = ZephPathFromFullPath(full);
    simulation.FileName = ZephNameFromFullPath(full);
    const EditorFileContext context{document->settings, document->paths, document->host, document->failures,
                                    document->watcher};
    return ZephSaveVisualizerXML(createdAtNow(), context, simulation) ? 0 : 1;
}
