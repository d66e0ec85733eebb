// The options of the program, on six tabs. The dialog works on a draft; whoever opened it takes the draft when it was
// accepted and stores it.
#pragma once

#include "shell/dialogs/option_controls.h"

#include <QDialog>

class QBoxLayout;
class QLabel;
class QLineEdit;
class QTabWidget;
class SampleView;

// What the dialog asks of whoever opens it.
struct OptionsDesk {
    Host& host;
    std::function<void()> resetAll;  // puts every setting back, in the store and in the program
    ColorPicker pickColor = ::pickColor;
};

class frmZephOptions : public QDialog {
public:
    // draft.Link: how the program is connected now. adapters: as just listed.
    frmZephOptions(ZephOptionsDraft draft, const ZephAdapters& adapters, OptionsDesk desk, QWidget* parent = nullptr);

    // The draft with what was entered; good once the dialog was accepted.
    const ZephOptionsDraft& draft() const { return draft_; }
    // The dialog ended with a reset: there is no draft to take.
    bool wasReset() const { return wasReset_; }

private:
    void cmdOK_Click();
    void cmdReset_Click();
    void cmbAdapter_Click();
    void takeControls();
    void showControls();
    void showPixelFlash(int speed);
    void showSample();

    QWidget* tooltipsTab();
    QWidget* generalTab();
    QWidget* colorsTab();
    QWidget* newFixturesTab();
    QWidget* bulbsTab();
    QWidget* communicationsTab();
    QBoxLayout* buttonRow();

    ZephOptionsDraft draft_;
    const Connection inUse_;
    const ZephAdapters& adapters_;
    OptionsDesk desk_;
    bool wasReset_ = false;

    OptionControls controls_;
    QTabWidget* tabOptions_;
    QLabel* lblPixelFlashSpeed_ = nullptr;
    ColorButton* cmdSampleBackgroundColor_ = nullptr;
    ColorButton* cmdSampleRGBColor_ = nullptr;
    SampleView* picSample_ = nullptr;
    QComboBox* cmbAssumeNewObject_ = nullptr;
    QLineEdit* txtZephPort_ = nullptr;
    QComboBox* cmbAdapter_ = nullptr;
    QLabel* lblLocalIP_ = nullptr;
    QCheckBox* chkUseTCP_ = nullptr;
};
