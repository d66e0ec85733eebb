// Lists the faults that keep a display from being simulated.
#pragma once

#include <QDialog>

class QPlainTextEdit;

class frmZephCompileErrors : public QDialog {
public:
    explicit frmZephCompileErrors(QWidget* parent = nullptr);

    // Line breaks may be CR LF.
    void SetErrorMessage(const QString& text);

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    QPlainTextEdit* txtError_;
};
