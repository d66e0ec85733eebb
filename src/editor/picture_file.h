// The background's picture file: which file a document means, and reading it. Called wherever a background is made,
// with and without a window.
#pragma once

#include "model/simulation.h"

#include <QImage>

#include <string>

// The picture in its own size, upright as the camera was held, Format_RGB32; what shines through it is white. Null for
// a file that is missing or no picture. The format goes by the content: photos travel under wrong extensions.
QImage loadPicture(const std::string& file);

// The full path of the picture of the document; "" where it names none. A relative PicFileName lies beside the editor
// file. Where there is no such file (the display has moved, perhaps from another machine), the end of the stored path
// is looked for beside and below the editor file, longest end first; where that fails too, the stored path.
std::string ZephFindBackgroundPicture(const ZephSimulation& simulation);
