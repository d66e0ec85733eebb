// The splash while the program starts, and the About box afterwards: the same picture, with the start's steps or a
// button below it.
#pragma once

#include <QDialog>

#include <string_view>

class QLabel;
class QPushButton;

class frmZephAbout : public QDialog {
public:
    enum class Purpose { Splash, About };

    // As a splash it stays until it is deleted: the user cannot close it while the program loads.
    explicit frmZephAbout(Purpose purpose, QWidget* parent = nullptr);

    // Shows a step of the start at once, before the step's work begins.
    void StartupMessage(std::string_view text);

protected:
    void closeEvent(QCloseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    Purpose purpose_;
    QLabel* lblStatus_;
    QPushButton* cmdOK_;
};
