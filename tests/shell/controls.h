// Finds and clicks what a window holds, by its names.
#pragma once

#include "util/failure.h"

#include <QTest>
#include <QWidget>

struct Controls {
    virtual ~Controls() = default;
    virtual QWidget& shown() = 0;

    template <typename Object>
    Object* find(const char* name) {
        auto* object = shown().findChild<Object*>(name);
        if (object == nullptr) throw Failure(std::string("there is no ") + name);
        return object;
    }
    void click(const char* name) { QTest::mouseClick(find<QWidget>(name), Qt::LeftButton); }
};
