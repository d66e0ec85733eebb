// Paints the example's background: a house on a clear winter night. Coordinates come from scene.h.
#pragma once

#include <QImage>

class QPainter;

QImage paintPicture();

// The layers of the picture, from the back to the front.
void paintSky(QPainter& painter);
void paintHills(QPainter& painter);
void paintHouse(QPainter& painter);
void paintGarden(QPainter& painter);
