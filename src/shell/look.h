// The looks of the program: a dark surround, so that lights are judged as at night.
#pragma once

#include <QIcon>

class QApplication;

void applyLook(QApplication& application);

// Pictures of the commands, drawn to be seen on the dark surround.
QIcon openIcon();
QIcon simulationIcon();
QIcon stopIcon();
