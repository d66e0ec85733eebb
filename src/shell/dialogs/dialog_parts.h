// What the program's dialogs are put together from, so that they look alike. Everything belongs to the layout that it
// is put in.
#pragma once

#include <QBoxLayout>
#include <QFormLayout>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>

inline constexpr int kDialogGapPx = 12;  // between the groups of a dialog, and around them

QGroupBox* groupBox(const QString& title, QLayout* inside);

// Labels to the left of their fields, which are as wide as they need be.
QFormLayout* labelledForm();

QHBoxLayout* rowOf(std::initializer_list<QWidget*> widgets);

// name: the objectName. Enter stays with the dialog's default button, wherever the focus stands.
QPushButton* pushButton(const char* name, const QString& text);

// A label for a value that the dialog changes: plain text, whatever a file's name holds.
QLabel* valueLabel(const char* name, const QString& text = {});

// OK and Cancel at the right end; OK is the default.
QHBoxLayout* closingRow(QPushButton* ok, QPushButton* cancel);

// A picture on the left, the groups beside it, the closing row below, all of a fixed size.
void layOutBesidePicture(QWidget* picture, std::initializer_list<QWidget*> groups, QHBoxLayout* closing,
                         QWidget& dialog);
