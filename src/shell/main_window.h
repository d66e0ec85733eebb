// The one main window, with two faces: the editor's canvas and the running simulation. It shows and forwards; what is
// to be done is decided by the procedures that its events call.
#pragma once

#include "editor/mode_commands.h"
#include "editor/object_operations.h"
#include "model/save_commands.h"
#include "shell/command_actions.h"
#include "shell/command_icons.h"
#include "shell/file_dialogs.h"
#include "shell/load_editor_file.h"
#include "shell/object_panel.h"
#include "shell/shutdown.h"
#include "shell/startup.h"
#include "shell/status_row.h"
#include "shell/tool_bars.h"
#include "shell/viewport.h"
#include "shell/window_host.h"
#include "shell/window_keys.h"

#include <QElapsedTimer>
#include <QMainWindow>
#include <QTimer>

class QSplitter;
class frmZephOpenGL;

class frmZephMain : public QMainWindow,
                    private SimulationFace,
                    private FileFace,
                    private ShutdownFace,
                    private SaveFace,
                    private AutoSaveFace,
                    private UndoFace,
                    public StartupFace {
public:
    frmZephMain(Program& program, WindowHost& host);
    ~frmZephMain() override;

    // Shows the window, restores its bars and opens the first file, if there is one.
    void start();
    // Brings the window of the simulation to the front if it runs and the setting "Force Simulation Forward" is on.
    void ForceForwardIfSimulating();

    bool openFile(const QString& path, bool quiet);

protected:
    void showEvent(QShowEvent* event) override;
    void closeEvent(QCloseEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    // Commands
    void runCommand(Command command);
    void mnuFileNew_Click();
    void mnuFileLoad_Click() override;
    void mnuRecentFiles_Click(int index) override;
    bool mnuFileSave_Click();  // true: the file was written
    void mnuFileSaveAs_Click();
    void mnuFileOptions_Click();
    void mnuFileExit_Click();
    void mnuBackgroundProperties_Click();
    void mnuHelpAbout_Click();
    void cmdStop_MouseUp();
    void sldIntensity_Scroll();
    void tmrAdjustBrightness_Timer();
    void tmrAutoSave_Timer();
    void tick();
    void dataArrived();

    // ModeFace
    void restoreIfMinimized() override;
    void eraseRubberBand() override;
    void setCanvasPointer(CanvasPointer pointer) override;
    void redrawObjects() override;
    void ZephHighlightflg(std::int32_t object) override;
    void ZephDeselectflg() override;
    void ZephLoadUIObjectList() override;
    void showPressedDrawButton() override;
    void showModeButtons() override;
    void CheckEnable(bool forceEnable) override;
    // SimulationFace
    void setTimer(bool on, int intervalMs) override;
    void showQueueGauge(bool shown) override;
    void showFrames(const QImage& frame) override;
    void SetControlsForSimulation(bool on) override;
    void layOutForEditor() override;
    GLTarget* ZephCreateRenderWindow() override;
    void resizeRenderWindow() override;
    void closeRenderWindow() override;
    void showMainWindow(bool shown) override;
    // StartupFace
    void setUpToolBars() override;
    void setUpMenus() override;
    bool openCommandLineFile(const std::string& file) override;
    // ShutdownFace
    bool saveDocument() override;
    void stopTimers() override;
    QRect windowPlace() const override;
    int windowState() const override;
    ToolBandLayout toolBands() const override { return toolBands_; }
    // SaveFace
    bool chooseOutputFile(std::string& fullPath) override;
    void addRecentFile(std::string_view fullPath) override;
    void documentSaved() override;
    // AutoSaveFace
    std::string statusPanel2() override;
    void save() override;
    // UndoFace
    void switchMode(int uiState) override;
    void documentReplaced(bool backgroundChanged) override;
    // FileFace
    void showDocument() override;
    void showOptionsBand() override;
    std::optional<ZephNewSimulationChoice> showNewSimulation() override;
    std::optional<ZephBackgroundDraft> showBackground(const ZephBackgroundDraft& draft,
                                                      const BackgroundTerms& terms) override;
    std::string findPicture(const std::string& missing) override;
    void setTitle(std::string_view windowTitle) override;

    void build();
    void connectControls();
    void placeAtStart();
    void keepFrameOnScreen();
    void showEditorControls(bool shown);
    void UpdateRecentFileMenu();
    EditContext editContext();
    // Asks before unsaved work is given up. True: go on.
    bool mayLoad(std::string_view titleSuffix);
    // A key that went down in this form. True where it is swallowed.
    bool keyDown(const QKeyEvent& event);
    KeyAnswer answerTo(const QKeyEvent& event) const;
    void carryOut(const KeyAnswer& answer);
    void moveListRow(bool backward);
    // The brightness that sldIntensity shows becomes the document's, at once.
    void takeIntensity();
    // Where the file dialog looks for pictures first.
    QString pictureFolder() const;
    void showContextMenu(const QPoint& globalPos);
    // Ends the simulation now, or behind the tick that is under way.
    void requestEnd();

    Program& program_;
    WindowHost& host_;
    ProgramModes modes_{program_, *this};
    WindowFileDialogs dialogs_{program_, host_};
    WindowKeys keys_;
    CommandStates states_;
    EditToolBarTexts texts_;

    std::unique_ptr<CommandActions> commands_;
    CoolBar* CoolBar1_ = nullptr;
    QSplitter* splitter_ = nullptr;
    ObjectPanel* objects_ = nullptr;
    CanvasViewport* canvas_ = nullptr;
    StatusRow* StatusBar1_ = nullptr;
    QTimer hrTimer1_{this};
    QTimer tmrAdjustBrightness_;
    QTimer tmrAutoSave_{this};
    int lastIntensity_ = 500;  // of sldIntensity at the timer's last tick; the first tick always sees a move

    bool movingList_ = false;      // the re-entry flag of the keyboard: Tab is moving the list
    bool inTick_ = false;          // a tick that arrives meanwhile does nothing
    bool endRequested_ = false;    // end the simulation once the tick under way is done
    bool closeRequested_ = false;  // and close the window then
    ToolBandLayout toolBands_;
    std::unique_ptr<frmZephOpenGL> frmZephOpenGL_;  // while the OpenGL engine simulates
    std::optional<QPoint> renderWindowPlace_;       // where it was closed last
    QElapsedTimer lastArrival_;                     // of text on the data link
    QRect editorPlace_;                             // while simulating: the window as it was before
};
