// The one main window, with two faces: the editor's canvas and the running simulation. It shows and forwards; what is
// to be done is decided by the procedures that its events call.
#pragma once

#include "shell/load_editor_file.h"
#include "shell/picture_box.h"
#include "shell/window_host.h"

#include <QMainWindow>
#include <QTimer>

#include <array>

class QAction;
class QLabel;
class QMenu;
class QProgressBar;
class QPushButton;
class QScrollArea;
class QToolBar;

class frmZephMain : public QMainWindow, private SimulationFace, private FileFace {
public:
    frmZephMain(Program& program, WindowHost& host);
    ~frmZephMain() override;

    // Shows the window and opens the file of the command line, if one was named.
    void start();

    bool openFile(const QString& path, bool quiet);

protected:
    void closeEvent(QCloseEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    // Events
    void mnuFileLoad_Click();
    void mnuFileExit_Click();
    void mnuHelpAbout_Click();
    void cmdStop_MouseUp();
    void tick();
    void dataArrived();

    // SimulationFace
    void setTimer(bool on, int intervalMs) override;
    void showQueueGauge(bool shown) override;
    void showFrames(const QImage& frame) override;
    void redrawObjects() override;
    void SetControlsForSimulation(bool on) override;
    void layOutForEditor() override;
    void CheckEnable() override;
    // FileFace
    void showDocument() override;
    void setTitle(std::string_view windowTitle) override;

    void showQueueLength(const QueueGaugeUpdate& update);

    void buildMenus();
    void buildToolBar();
    void buildCanvas();
    void buildStatusBar();
    void placeAtStart();
    // Ends the simulation now, or behind the tick that is under way.
    void requestEnd();
    void toggleSimulation();

    Program& program_;
    WindowHost& host_;

    QMenu* mnufile_ = nullptr;
    QAction* mnuFileLoad_ = nullptr;
    QAction* mnuFileExit_ = nullptr;
    QMenu* mnuEdit_ = nullptr;
    QAction* mnuSimulationMode_ = nullptr;
    QMenu* mnuHelp_ = nullptr;
    QToolBar* CoolBar1_ = nullptr;
    QScrollArea* picViewport_ = nullptr;
    PictureBox* picMain_ = nullptr;
    std::array<QLabel*, 5> panels_{};  // 1..4
    QPushButton* cmdStop_ = nullptr;
    QProgressBar* prbQueueLen_ = nullptr;
    QTimer hrTimer1_;

    bool inTick_ = false;          // a tick that arrives meanwhile does nothing
    bool endRequested_ = false;    // end the simulation once the tick under way is done
    bool closeRequested_ = false;  // and close the window then
    QRect editorPlace_;            // while simulating: the window as it was before
};
