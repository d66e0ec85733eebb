// The picture behind the display: found, loaded, stretched to the canvas and darkened. Made here without a window, for
// the canvas, the simulation and the headless companion alike.
#pragma once

#include "model/simulation.h"
#include "util/host.h"

#include <QImage>

#include <string>

// Brightness 0..100 as what is added to every byte of colour: floor((100 - intensity) x -2.55), 0..-255.
std::int32_t brightnessOffset(std::int32_t intensity) noexcept;

// Adds the offset to every byte of colour, held to 0..255. A picture of Format_RGB32.
void ZephDrawFastBrightness(std::int32_t offset, QImage& picture);

// The canvas in pixels, each way held to 1..2500.
QSize canvasSize(const ZephBackground& background) noexcept;

// The picture stretched to the canvas of the background record at its PicIntensity: Format_RGB32, canvasSize.
QImage ZephResizeAndSetBackgroundIntensity(const QImage& picture, const ZephBackground& background);

// Where the picture of the document lies: a relative PicFileName lies beside the editor file, so that a display and
// its picture travel together.
std::string backgroundPicturePath(const ZephSimulation& simulation);

// The picture for the OpenGL output, which dims it by itself: stretched to the canvas at its own brightness. Null where
// the background is no picture. One that cannot be loaded is told and replaced as below.
QImage ZephGLPicture(const ZephSimulation& simulation, const std::string& programFolder, Host& host);

// The background of a document just loaded or created, ready to draw on. A picture that cannot be loaded is told in a
// box and the blank picture of the program's folder takes its place; if that is missing too, another box, and white.
QImage ZephResetBackground(const ZephSimulation& simulation, const std::string& programFolder, Host& host);
