// Opens a display: the editor file, or a document kept by undo and redo, becomes the records of the one document.
#pragma once

#include "model/document.h"
#include "model/document_snapshot.h"
#include "model/document_source.h"
#include "util/failure.h"
#include "util/host.h"
#include "util/paths.h"

// What loading and saving use besides the document itself.
struct EditorFileContext {
    const ZephSettings& settings;
    const ZephPathService& paths;
    Host& host;
    FailureReport& failures;
    DocumentWatcher& watcher;
};

// Loads the file FilePath + FileName of the document (source 0) and replaces what was open. False when the file is no
// editor file, in which case the document may stay as it was, or when any record failed: the document then holds what
// could be read. showErrors false keeps every message box back; the failures of single records are reported always.
[[nodiscard]] bool ZephLoadVisualizerXML(bool showErrors, const EditorFileContext& context, ZephSimulation& simulation);

// Loads a document that undo or redo kept. Such a document is of the present version and carries no checksum, and the
// caller has emptied the records before.
[[nodiscard]] bool ZephLoadVisualizerXML(const DocumentSnapshot& stored, bool showErrors,
                                         const EditorFileContext& context, ZephSimulation& simulation);

// As the file of that text, already in memory. The name stands in the messages. QuickOnly gives false, silently and
// without touching a record, where the quick form gives up.
[[nodiscard]] bool loadEditorText(std::string_view text, TextReading reading, bool showErrors,
                                  const EditorFileContext& context, ZephSimulation& simulation);
