#include "paint_picture.h"

#include <QGuiApplication>

#include <cstdio>

int main(int argc, char** argv) {
    if (argc != 2) {
        std::fprintf(stderr, "usage: zeph-make-example FOLDER\n");
        return 2;
    }
    const QGuiApplication application(argc, argv);  // QPainter needs its fonts and colours
    const QString folder = QString::fromLocal8Bit(argv[1]);
    if (!paintPicture().save(folder + "/house.png")) {
        std::fprintf(stderr, "house.png cannot be written to %s\n", argv[1]);
        return 1;
    }
    return 0;
}
