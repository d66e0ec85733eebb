// The looks of the program: by default a dark surround, so that lights are judged as at night, or a light one.
#pragma once

#include <QIcon>

class QApplication;

// ZEPH_LOOK=light in the environment asks for the light surround.
void applyLook(QApplication& application);

// The program's own icon.
QIcon simulationIcon();
