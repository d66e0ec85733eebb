// The main window's commands: what menus, buttons, keys and the object list lead to, and showing what is available.
#include "editor/insert_object.h"
#include "editor/undo_commands.h"
#include "shell/dialogs/about_dialog.h"
#include "shell/edit_options.h"
#include "shell/main_window.h"
#include "shell/recent_files.h"

#include <QAction>
#include <QApplication>
#include <QKeyEvent>
#include <QMenu>

namespace {

constexpr std::string_view kModule = "frmZephMain";

CommandInputs commandInputs(const Program& program) {
    return {*program.simulation,
            program.editor,
            {program.undo.UndoPosition, program.undo.RedoPosition},
            program.settings.FixtureTextLocation,
            false};
}

}  // namespace

void frmZephMain::runCommand(Command command) try {
    takeIntensity();  // no command, least of all a save, may find the slider ahead of the document
    switch (command) {
    case Command::FileNew:
        mnuFileNew_Click();
        break;
    case Command::FileLoad:
        mnuFileLoad_Click();
        break;
    case Command::FileSave:
        mnuFileSave_Click();
        break;
    case Command::FileSaveAs:
        mnuFileSaveAs_Click();
        break;
    case Command::FileOptions:
        mnuFileOptions_Click();
        break;
    case Command::FileExit:
        mnuFileExit_Click();
        return;
    case Command::Undo:
        mnuUndo_Click(editContext());
        break;
    case Command::Redo:
        mnuRedo_Click(editContext());
        break;
    case Command::InsertFixture:
        mnuInsertFixture_Click(editContext());
        break;
    case Command::InsertProp:
        mnuInsertProp_Click(editContext());
        break;
    case Command::ItemTool:
        mnuItemTool_Click(modes_.context());
        break;
    case Command::Select:
        mnuSelect_Click(modes_.context());
        break;
    case Command::SimulationMode:
        ::mnuSimulationMode_Click(program_, *this);
        break;
    case Command::BackgroundProperties:
        mnuBackgroundProperties_Click();
        break;
    case Command::HelpAbout:
        mnuHelpAbout_Click();
        break;
    default:
        if (const int tool = commandTool(command); tool != 0) drawTool_Click(tool, modes_.context());
        break;
    }
    showPressedDrawButton();  // the control has changed itself at the click
}
ZEPH_GUARD(program_.failures, kModule, )

bool frmZephMain::openFile(const QString& path, bool quiet) {
    setEditorFile(path.toStdString(), *program_.simulation);
    const bool loaded = LoadEditorFile(quiet, program_, *this, *this);
    if (loaded) {
        addRecentFile(program_.simulation->FilePath + program_.simulation->FileName);
    } else {
        program_.simulation->FilePath.clear();
        program_.simulation->FileName.clear();
        ZephLoadUIObjectList();
    }
    CheckEnable(false);
    return loaded;
}

bool frmZephMain::mayLoad(std::string_view titleSuffix) {
    ZephSwitchMode(kStateSelectFixture, program_, *this);
    if (!program_.simulation->SimulationDirty) return true;
    return host_.messageBox(boxTitle(titleSuffix),
                            "This editor session has not been saved.  Are you sure you want to load a new one?",
                            BoxIcon::Question, BoxButtons::YesNo) == BoxAnswer::Yes;
}

void frmZephMain::mnuFileLoad_Click() try {
    if (mayLoad("-Load?")) {
        std::string file;
        if (dialogs_.chooseInput(kLoadEditorFile, file)) openFile(QString::fromStdString(file), false);
    }
    CheckEnable(false);
}
ZEPH_GUARD(program_.failures, kModule, )

void frmZephMain::mnuRecentFiles_Click(int index) try {
    const std::string file = program_.settings.RecentFiles.at(static_cast<std::size_t>(index));
    if (mayLoad("-Load Recent File?")) openFile(QString::fromStdString(file), false);
    CheckEnable(false);
}
ZEPH_GUARD(program_.failures, kModule, )

void frmZephMain::UpdateRecentFileMenu() {
    QStringList captions;
    for (const std::string& caption : ZephRecentFileCaptions(program_.settings, program_.paths))
        captions.append(QString::fromStdString(caption));
    commands_->showRecentFiles(captions);
}

void frmZephMain::mnuFileOptions_Click() {
    program_.editor.ZephSelection.Object = 0;
    ZephDeselectflg();
    redrawObjects();
    host_.setStatusPanel(2, ZephUpdateStatusBarForUIState(*program_.simulation, program_.editor, false));
    CheckEnable(false);
    const OptionsOutcome outcome =
        ZephEditOptions(registryContext(program_), this, program_.settings, program_.connection, program_.adapters);
    if (outcome == OptionsOutcome::Kept) return;
    // What shows at once.
    program_.editor.SimplePropMode = program_.settings.SimplePropDisplay;
    program_.RenderEngine = renderEngineOf(program_.settings);
    if (outcome == OptionsOutcome::Reset) {
        toolBands_ = ZephInitializeFromRegistryCoolbar(program_.seams.store, program_.failures);
        CoolBar1_->arrange(toolBands_);
        UpdateRecentFileMenu();
    }
    ZephLoadUIObjectList();
    redrawObjects();
    showOptionsBand();
    CheckEnable(false);
}

void frmZephMain::mnuFileExit_Click() {
    restoreIfMinimized();
    close();
}

void frmZephMain::mnuHelpAbout_Click() {
    frmZephAbout(frmZephAbout::Purpose::About, this).exec();
}

void frmZephMain::cmdStop_MouseUp() {
    requestEnd();
}

void frmZephMain::restoreIfMinimized() {
    if (isMinimized()) showNormal();
}

void frmZephMain::eraseRubberBand() {
    // The band is no part of the composed canvas, so showing that again takes it away.
    canvas_->picMain().update();
}

void frmZephMain::setCanvasPointer(CanvasPointer pointer) {
    if (pointer == CanvasPointer::Pencil) {
        canvas_->picMain().setCursor(pencilPointer(devicePixelRatioF()));
    } else {
        canvas_->picMain().unsetCursor();
    }
}

void frmZephMain::ZephHighlightflg(std::int32_t object) {
    objects_->ZephHighlightflg(object);
}

void frmZephMain::ZephDeselectflg() {
    objects_->ZephDeselectflg();
}

void frmZephMain::ZephLoadUIObjectList() try {
    objects_->showRows(ZephListIndex(*program_.simulation, program_.editor));
    objects_->showSimplePropMode(program_.editor.SimplePropMode, program_.editor.ZephUIState == kStateSelectProp);
}
ZEPH_GUARD(program_.failures, kModule, )

void frmZephMain::showPressedDrawButton() {
    for (const CommandRow& row : kCommandTable) {
        if (row.kind != CommandKind::Toggle) continue;
        commands_->action(row.id)->setChecked(row.drawButton == program_.editor.PressedDrawButton);
    }
}

void frmZephMain::showModeButtons() {
    objects_->showModeButtons(program_.editor.ZephChangeToggle);
}

void frmZephMain::CheckEnable(bool forceEnable) try {
    const CommandInputs inputs = commandInputs(program_);
    ::CheckEnable(forceEnable, inputs, states_);
    SetEditToolBarTips(*program_.simulation, program_.editor, program_.undo, texts_);
    const bool frozen = program_.simulating() || drawingInProgress(program_.editor);
    commands_->show(states_, frozen);
    commands_->show(texts_);
    CoolBar1_->show(states_, frozen);
    objects_->setModeButtonsEnabled(program_.simulation->SimulationOpen && !frozen);
    objects_->showSimplePropMode(program_.editor.SimplePropMode, program_.editor.ZephUIState == kStateSelectProp);
}
ZEPH_GUARD(program_.failures, kModule, )

bool frmZephMain::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::KeyPress && event->type() != QEvent::ShortcutOverride) {
        return QMainWindow::eventFilter(watched, event);
    }
    const auto& key = *static_cast<QKeyEvent*>(event);
    if (event->type() == QEvent::KeyPress) return keyDown(key);
    // A key that the form takes is no shortcut: it comes again as a key that went down.
    if (answerTo(key).action == KeyAction::None) return false;
    event->accept();
    return true;
}

KeyAnswer frmZephMain::answerTo(const QKeyEvent& event) const {
    KeyDown down = keyDownOf(event);
    down.ctrl = down.ctrl || keys_.CtPressed();
    down.shift = down.shift || keys_.ShPressed();
    const bool focusInForm = isActiveWindow() && QApplication::activeModalWidget() == nullptr &&
                             QApplication::activePopupWidget() == nullptr;
    return IWindowsHook_HookProc(down, {focusInForm, movingList_}, commandInputs(program_), states_.popContextMenu);
}

bool frmZephMain::keyDown(const QKeyEvent& event) {
    const KeyAnswer answer = answerTo(event);
    if (answer.action == KeyAction::None) return false;
    carryOut(answer);
    return true;
}

void frmZephMain::carryOut(const KeyAnswer& answer) try {
    switch (answer.action) {
    case KeyAction::StopSimulation:
        requestEnd();
        break;
    case KeyAction::RunCommand:
        commands_->action(answer.command)->trigger();
        break;
    case KeyAction::ShowContextMenu:
        showContextMenu(QCursor::pos());
        break;
    case KeyAction::NextRow:
    case KeyAction::PreviousRow:
        moveListRow(answer.action == KeyAction::PreviousRow);
        break;
    case KeyAction::CancelDrawing:
        cancelStroke(modes_.context());
        break;
    case KeyAction::FinishDrawing:  // no stroke can be under way before the canvas takes the mouse
    case KeyAction::None:
        break;
    }
}
ZEPH_GUARD(program_.failures, kModule, )

void frmZephMain::moveListRow(bool backward) {
    if (objects_->rows() < 1) return;
    movingList_ = true;
    const int row = nextListRow(objects_->highlightedRow(), objects_->rows(), backward);
    flgObjectSelect_Click(objects_->objectOfRow(row), modes_.context());
    movingList_ = false;
}

void frmZephMain::showContextMenu(const QPoint& globalPos) {
    if (states_.popContextMenu && !program_.simulating()) commands_->contextMenu()->popup(globalPos);
}
