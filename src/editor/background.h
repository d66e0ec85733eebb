// The picture behind the display: stretched to the canvas and darkened. Made here without a window, for the canvas,
// the simulation and the headless companion alike.
#pragma once

#include "model/simulation.h"
#include "util/host.h"

#include <QImage>

#include <string>

// The surfaces that a background is turned into, both of canvasSize and Format_RGB32.
struct ZephBackgroundSurfaces {
    QImage Picture3;             // the picture at its own brightness: what the OpenGL output dims by itself
    QImage picBackground;        // the picture at PicIntensity
    bool pictureFailed = false;  // a picture was wanted and could not be loaded
};

// Which texts tell that a picture failed: those of the background dialog end in a number.
enum class BackgroundTexts { Reset, Change };

// Brightness 0..100 as what is added to every byte of colour: floor((100 - intensity) x -2.55), 0..-255.
std::int32_t brightnessOffset(std::int32_t intensity) noexcept;

// Adds the offset to every byte of colour, held to 0..255. A picture of Format_RGB32.
void ZephDrawFastBrightness(std::int32_t offset, QImage& picture);

// The canvas in pixels, each way held to 1..2500.
QSize canvasSize(const ZephBackground& background) noexcept;

// Picture3 at the intensity 0..100; at 100 they share their pixels.
QImage pictureAtIntensity(const QImage& Picture3, std::int32_t intensity);

// The picture in its own size stretched, not cropped, to the canvas of the record, and darkened to its PicIntensity.
ZephBackgroundSurfaces ZephResizeAndSetBackgroundIntensity(const QImage& Image1, const ZephBackground& background);

// Loads the picture of the document, or the blank one of the program's folder, and makes the surfaces of it. A picture
// that cannot be loaded is told in a box and the blank one takes its place; if that is missing too, another box, and
// white.
ZephBackgroundSurfaces loadBackground(const ZephSimulation& simulation, const std::string& programFolder,
                                      BackgroundTexts texts, Host& host);

// The same for a document just loaded or created.
ZephBackgroundSurfaces ZephResetBackground(const ZephSimulation& simulation, const std::string& programFolder,
                                           Host& host);

// What a canvas without a picture shows.
QImage whitePicture();

// What a dialog shows of a background: the canvas as large as it goes into the room, both in pixels, but no larger
// than it is. Null where there is no picture.
QImage previewPicture(const QImage& Image1, QSize canvas, QSize room);
