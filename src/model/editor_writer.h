// Saves the display: the document's records become the text of an editor file of the present version.
#pragma once

#include "model/editor_loader.h"

#include <string>

// The text of the document without a checksum, as undo and redo keep it. createdAt: see createdAtNow.
std::string editorText(const ZephSimulation& simulation, const ZephPathService& paths, std::string_view createdAt);

// Sets the checksum of such a text. A document whose ChecksumMismatch is set gets one that will not verify, so that
// the mark outlives every save.
void AddHash(bool checksumMismatch, std::string& text);

// Replaces the file FilePath + FileName (destination 0), whole or not at all. A failure of the disk is told in a
// message; any other is reported, and nothing is written. False in both cases; the commands that save go on as if it
// had succeeded.
bool ZephSaveVisualizerXML(std::string_view createdAt, const EditorFileContext& context,
                           const ZephSimulation& simulation);
