// A new size for the canvas, in pixels, with or without its proportions.
#pragma once

#include "util/host.h"

#include <QDialog>

class NumberField;
class QCheckBox;

class frmZephChangeSize : public QDialog {
public:
    // size: as the canvas is now; its proportions are kept.
    frmZephChangeSize(QSize size, Host& host, QWidget* parent = nullptr);

    bool Cancelled() const { return result() != Accepted; }
    QSize newSize() const { return newSize_; }  // good once the dialog was accepted

private:
    void cmdOK_Click();
    // A box was typed into: the other one follows.
    void followProportions(const NumberField& typed, int typedSide, int otherSide, NumberField& other);

    const QSize atOpening_;
    QSize newSize_;
    Host& host_;
    NumberField* txtNewWidth_;
    NumberField* txtNewHeight_;
    QCheckBox* chkAspect_;
};
