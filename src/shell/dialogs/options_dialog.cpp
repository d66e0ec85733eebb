#include "shell/dialogs/options_dialog.h"

#include "shell/dialogs/dialog_parts.h"
#include "shell/dialogs/sample_view.h"

#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>
#include <QTabWidget>

namespace {

constexpr int kFlashStepMs = 40;  // a step of the pixel flash speed
constexpr const char* kDeadAddressStyle = "background: #a8322a; color: white; border-radius: 3px; padding: 3px 6px;";
constexpr const char* kLiveAddressStyle = "padding: 3px 0;";

}  // namespace

frmZephOptions::frmZephOptions(ZephOptionsDraft draft, const ZephAdapters& adapters, OptionsDesk desk, QWidget* parent)
    : QDialog(parent), draft_(std::move(draft)), inUse_(draft_.Link), adapters_(adapters), desk_(std::move(desk)),
      controls_(desk_.pickColor), tabOptions_(new QTabWidget) {
    setObjectName("frmZephOptions");
    setWindowTitle(QString::fromStdString(boxTitle("-Options")));

    tabOptions_->setObjectName("tabOptions");
    tabOptions_->setUsesScrollButtons(false);  // the dialog is as wide as its tabs
    tabOptions_->addTab(tooltipsTab(), tr("Tooltips"));
    tabOptions_->addTab(generalTab(), tr("General"));
    tabOptions_->addTab(colorsTab(), tr("Samples and Colors"));
    tabOptions_->addTab(newFixturesTab(), tr("New Fixtures"));
    tabOptions_->addTab(bulbsTab(), tr("Bulbs and Warnings"));
    tabOptions_->addTab(communicationsTab(), tr("Communications"));

    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(12, 12, 12, 12);
    layout->setSpacing(12);
    layout->addWidget(tabOptions_);
    layout->addLayout(buttonRow());
    showControls();
}

QBoxLayout* frmZephOptions::buttonRow() {
    QPushButton* cmdReset = pushButton("cmdReset", tr("&Reset All..."));
    QPushButton* cmdOK = pushButton("cmdOK", tr("OK"));
    QPushButton* cmdCancel = pushButton("cmdCancel", tr("Cancel"));
    cmdReset->setToolTip(tr("Puts every option back to what it was when the program was installed"));
    connect(cmdReset, &QPushButton::clicked, this, &frmZephOptions::cmdReset_Click);
    connect(cmdOK, &QPushButton::clicked, this, &frmZephOptions::cmdOK_Click);
    connect(cmdCancel, &QPushButton::clicked, this, &QDialog::reject);
    QHBoxLayout* row = closingRow(cmdOK, cmdCancel);
    row->insertWidget(0, cmdReset);
    return row;
}

void frmZephOptions::showControls() {
    const ZephSettings& settings = draft_.Settings;
    controls_.show(settings);
    cmbAssumeNewObject_->setCurrentIndex(settings.AssumeNewObject ? 1 : 0);
    txtZephPort_->setText(QString::fromStdString(draft_.PortText));
    chkUseTCP_->setChecked(draft_.Link.ZephUseTCP);
    const QString adapter = QString::fromStdString(draft_.Link.ZephAdapterName);
    cmbAdapter_->setPlaceholderText(adapter);
    cmbAdapter_->setCurrentIndex(cmbAdapter_->findText(adapter, Qt::MatchExactly | Qt::MatchCaseSensitive));
    cmbAdapter_Click();
    showSample();
    tabOptions_->setCurrentIndex(settings.LastOptsTab);
}

void frmZephOptions::takeControls() {
    ZephSettings& settings = draft_.Settings;
    controls_.take(settings);
    settings.AssumeNewObject = cmbAssumeNewObject_->currentData().toBool();
    settings.LastOptsTab = tabOptions_->currentIndex();
    draft_.PortText = txtZephPort_->text().toStdString();
    draft_.Link.ZephUseTCP = chkUseTCP_->isChecked();
    if (cmbAdapter_->currentIndex() < 0) return;  // the adapter in use is not on this machine now
    const ZephAdapter& adapter = adapters_[cmbAdapter_->currentData().toInt()];
    draft_.Link.ZephAdapterName = adapter.Name;
    draft_.Link.ZephAdapterIP = adapter.IpAddress;
}

void frmZephOptions::cmbAdapter_Click() {
    const bool chosen = cmbAdapter_->currentIndex() >= 0;
    const std::string& ip =
        chosen ? adapters_[cmbAdapter_->currentData().toInt()].IpAddress : draft_.Link.ZephAdapterIP;
    lblLocalIP_->setText(QString::fromStdString(ZephLocalIPText(ip)));
    lblLocalIP_->setStyleSheet(ZephIsDeadAddress(ip) ? kDeadAddressStyle : kLiveAddressStyle);
}

void frmZephOptions::showPixelFlash(int speed) {
    lblPixelFlashSpeed_->setText(tr("%1 ms").arg(speed * kFlashStepMs));
}

void frmZephOptions::showSample() {
    picSample_->setColors(toQColor(cmdSampleBackgroundColor_->color()), toQColor(cmdSampleRGBColor_->color()));
}

void frmZephOptions::cmdOK_Click() {
    takeControls();
    if (ZephAcceptOptions(inUse_, desk_.host, draft_)) {
        accept();
        return;
    }
    tabOptions_->setCurrentIndex(kCommunicationsTab);
    txtZephPort_->setFocus();
    txtZephPort_->selectAll();
}

void frmZephOptions::cmdReset_Click() {
    if (!ZephResetOptions(desk_.host, desk_.resetAll)) return;
    wasReset_ = true;
    reject();
}
