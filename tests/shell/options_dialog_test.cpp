#include "shell/dialogs/options_dialog.h"
#include "shell/edit_options.h"
#include "tests/shell/settings_rig.h"

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QRegularExpression>
#include <QSlider>
#include <QSpinBox>
#include <QTabWidget>
#include <QTest>
#include <QTimer>

namespace {

struct OptionsDialog : testing::Test, SettingsRig {
    OptionsDialog() {
        store.set("Adapter To Use", "Stage");
        EXPECT_TRUE(read());
    }
    // Makes and shows the dialog on what the test has set up.
    void open() {
        const auto pick = [this](std::int32_t, const QString&, QWidget*) { return picked; };
        const OptionsDesk desk{host, [this] { ++resets; }, pick};
        dialog = std::make_unique<frmZephOptions>(ZephOptionsDraftOf(settings, connection), adapters, desk);
        dialog->show();
    }
    template <typename Widget>
    Widget* find(const char* name) {
        Widget* widget = dialog->findChild<Widget*>(name);
        if (widget == nullptr) throw Failure(std::string("there is no ") + name);
        return widget;
    }
    void click(const char* name) { QTest::mouseClick(find<QPushButton>(name), Qt::LeftButton); }
    void choose(const char* name, const QString& text) {
        auto* box = find<QComboBox>(name);
        ASSERT_GE(box->findText(text), 0) << name;
        box->setCurrentIndex(box->findText(text));
    }
    bool accepted() const { return dialog->result() == QDialog::Accepted && !dialog->isVisible(); }

    std::optional<std::int32_t> picked;
    int resets = 0;
    std::unique_ptr<frmZephOptions> dialog;
};

}  // namespace

TEST_F(OptionsDialog, OkWithoutAChangeGivesTheSettingsBackAsTheyWere) {
    settings.AutoSave = 7;  // in the store by another hand: no list offers it
    settings.ZOrder = 0;
    settings.FloodOpacity = 52;
    settings.LastOptsTab = 3;
    open();
    EXPECT_EQ(find<QTabWidget>("tabOptions")->count(), 6);
    EXPECT_EQ(find<QTabWidget>("tabOptions")->currentIndex(), 3);
    EXPECT_EQ(find<QComboBox>("cmbAutoSave")->placeholderText(), "7 Minutes");
    EXPECT_EQ(find<QComboBox>("cmbMaxOpacity")->placeholderText(), "52 %");
    EXPECT_FALSE(find<QComboBox>("cmbKeshBulbShape")->isEnabled());
    EXPECT_EQ(find<QComboBox>("cmbKeshBulbShape")->currentText(), "Pixel Bulb");
    click("cmdOK");
    ASSERT_TRUE(accepted());
    EXPECT_EQ(dialog->draft().Settings, settings);
    EXPECT_TRUE(host.boxes.empty());
}

TEST_F(OptionsDialog, EveryControlChangesItsOwnSettingAndNoOther) {
    write();
    auto wanted = store.values;
    const auto want = [&](const QString& name, const QString& value) {
        wanted[{lowerCase(kSettingsKey), lowerCase(name.toStdString())}] = value.toStdString();
    };
    open();
    static const QRegularExpression row("^(\\w+) ?\"?([^\"]*)\"? : (.+) = (.+)$");
    for (const QString& line : tableLines("option_controls.txt")) {
        const QStringList parts = row.match(line).capturedTexts();
        ASSERT_EQ(parts.size(), 5) << line.toStdString();
        const QByteArray name = parts[1].toLatin1();
        auto* control = find<QWidget>(name);
        if (auto* box = qobject_cast<QCheckBox*>(control)) box->toggle();
        if (qobject_cast<QComboBox*>(control)) choose(name, parts[2].trimmed());
        if (auto* slider = qobject_cast<QSlider*>(control)) slider->setValue(parts[2].toInt());
        if (auto* spin = qobject_cast<QSpinBox*>(control)) spin->setValue(parts[2].toInt());
        picked = parts[2].toInt();
        if (qobject_cast<QPushButton*>(control)) click(name);
        want(parts[3], parts[4]);
    }
    EXPECT_EQ(find<QLabel>("lblPixelFlashSpeed")->text(), "1000 ms");
    find<QTabWidget>("tabOptions")->setCurrentIndex(5);
    want("Last Opts Tab", "5");
    find<QLineEdit>("txtZephPort")->setFocus();
    find<QLineEdit>("txtZephPort")->selectAll();
    QTest::keyClicks(find<QLineEdit>("txtZephPort"), "4a-0 .00x");
    want("Simulation Port", "4000");
    click("cmdOK");
    ASSERT_TRUE(accepted());
    settings = dialog->draft().Settings;
    write();
    EXPECT_EQ(store.values, wanted);
    EXPECT_EQ(dialog->draft().Link.ZephAdapterName, "Local");
    EXPECT_EQ(dialog->draft().Link.ZephAdapterIP, "127.0.0.1");
    EXPECT_EQ(dialog->draft().Link.ZephSimulationPort, 4000);
    EXPECT_TRUE(dialog->draft().Link.ZephUseTCP);
}

TEST_F(OptionsDialog, AColorThatWasNotChosenStays) {
    open();
    click("cmdToolHandleColor");  // the color dialog is left without a choice
    EXPECT_EQ(find<QPushButton>("cmdToolHandleColor")->text(), "#FF0000");
    picked = 0xFF0000;  // blue stands highest
    click("cmdToolHandleColor");
    EXPECT_EQ(find<QPushButton>("cmdToolHandleColor")->text(), "#0000FF");
}

TEST_F(OptionsDialog, AWrongPortLeadsToItsField) {
    settings.LastOptsTab = 1;
    connection.ZephSimulationPort = 0;
    open();
    ASSERT_TRUE(QTest::qWaitForWindowActive(dialog.get()));
    click("cmdOK");
    EXPECT_TRUE(dialog->isVisible());
    ASSERT_EQ(host.boxes.size(), 1u);
    EXPECT_EQ(host.boxes[0].title, "Qen Visualizer-Port Error");
    EXPECT_EQ(find<QTabWidget>("tabOptions")->currentIndex(), 5);
    EXPECT_EQ(QApplication::focusWidget(), find<QLineEdit>("txtZephPort"));
    QTest::keyClicks(QApplication::focusWidget(), "65535");
    click("cmdOK");
    EXPECT_TRUE(accepted());
    EXPECT_EQ(dialog->draft().Settings.SimulationPort, 65535);
}

TEST_F(OptionsDialog, AnAdapterShowsItsAddress) {
    connection.ZephAdapterName = "Gone";
    connection.ZephAdapterIP = "127.0.0.1";
    open();
    EXPECT_EQ(find<QComboBox>("cmbAdapter")->count(), 3);
    EXPECT_EQ(find<QComboBox>("cmbAdapter")->currentIndex(), -1);
    EXPECT_EQ(find<QComboBox>("cmbAdapter")->placeholderText(), "Gone");
    EXPECT_EQ(find<QLabel>("lblLocalIP")->text(), "IP address: 127.0.0.1");
    find<QTabWidget>("tabOptions")->setCurrentIndex(5);
    const auto ground = [this] { return find<QLabel>("lblLocalIP")->grab().toImage().pixelColor(4, 4); };
    const QColor usual = ground();
    choose("cmbAdapter", "Spare");
    EXPECT_EQ(find<QLabel>("lblLocalIP")->text(), "IP address: 0.0.0.0");
    EXPECT_GT(ground().red(), 2 * ground().green());
    choose("cmbAdapter", "Stage");
    EXPECT_EQ(ground(), usual);
}

TEST_F(OptionsDialog, CancelAndResetGiveNoDraft) {
    open();
    find<QCheckBox>("chkConfirmDeletes")->toggle();
    click("cmdCancel");
    EXPECT_FALSE(accepted());
    EXPECT_FALSE(dialog->wasReset());

    open();
    host.answers = {BoxAnswer::Cancel, BoxAnswer::Ok};
    click("cmdReset");
    EXPECT_TRUE(dialog->isVisible());
    click("cmdReset");
    EXPECT_FALSE(dialog->isVisible());
    EXPECT_TRUE(dialog->wasReset());
    EXPECT_EQ(resets, 1);
    const std::string asked = "Qen Visualizer-Reset Options to Defaults?|Are you sure you want to reset all options to "
                              "defaults?\r\nNote: This operation will reset your entire environment\r\nincluding "
                              "editor colors, recent files, toolbar locations, etc\n";
    EXPECT_EQ(host.boxTexts(),
              asked + asked + "Qen Visualizer-Reset Options to Defaults|All options reset to defaults");
}

namespace {

// Opens the dialog as the menu does and works it from inside its own event loop.
OptionsOutcome editOptions(SettingsRig& rig, const std::function<void(frmZephOptions&)>& work) {
    QTimer::singleShot(0, [&] {
        auto* dialog = dynamic_cast<frmZephOptions*>(QApplication::activeModalWidget());
        ASSERT_NE(dialog, nullptr);
        work(*dialog);
        if (dialog->isVisible()) dialog->reject();
    });
    return ZephEditOptions(rig.context, nullptr, rig.settings, rig.connection, rig.adapters);
}

void clickIn(frmZephOptions& dialog, const char* name) {
    QTest::mouseClick(dialog.findChild<QPushButton*>(name), Qt::LeftButton);
}

}  // namespace

TEST(EditOptions, StoresAtOnceWhatWasAccepted) {
    SettingsRig rig;
    ASSERT_TRUE(rig.read());
    rig.connection.ZephPortOpen = true;
    const OptionsOutcome outcome = editOptions(rig, [](frmZephOptions& dialog) {
        EXPECT_EQ(dialog.findChild<QComboBox*>("cmbAdapter")->count(), 3);  // listed anew
        dialog.findChild<QCheckBox*>("chkUseTCP")->setChecked(true);
        dialog.findChild<QCheckBox*>("chkConfirmDeletes")->setChecked(false);
        clickIn(dialog, "cmdOK");
    });
    EXPECT_EQ(outcome, OptionsOutcome::Stored);
    EXPECT_FALSE(rig.settings.ConfirmDeletes);
    EXPECT_TRUE(rig.connection.ZephUseTCP);  // for the rest of this run
    EXPECT_TRUE(rig.connection.ZephPortOpen);
    EXPECT_EQ(rig.store.get("Confirm Deletes"), "False");
    EXPECT_EQ(rig.store.get("ShutDownTime"), "(absent)");
    ASSERT_EQ(rig.host.boxes.size(), 1u);
    EXPECT_EQ(rig.host.boxes[0].title, "Qen Visualizer-Port Changed");
}

TEST(EditOptions, AResetReachesStoreSettingsAndConnection) {
    SettingsRig rig;
    ASSERT_TRUE(rig.read());
    rig.settings.ConfirmDeletes = false;
    rig.settings.RecentFiles[0] = "/a.zee";
    rig.connection.ZephSimulationPort = 4000;
    rig.write();
    const ZephSettings before = rig.settings;
    EXPECT_EQ(editOptions(rig, [](frmZephOptions& dialog) { clickIn(dialog, "cmdCancel"); }), OptionsOutcome::Kept);
    EXPECT_EQ(rig.settings, before);
    rig.host.answers = {BoxAnswer::Ok};
    EXPECT_EQ(editOptions(rig, [](frmZephOptions& dialog) { clickIn(dialog, "cmdReset"); }), OptionsOutcome::Reset);
    EXPECT_TRUE(rig.settings.ConfirmDeletes);
    EXPECT_EQ(rig.settings.RecentFiles[0], "");
    EXPECT_EQ(rig.connection.ZephSimulationPort, 30303);
    EXPECT_EQ(rig.store.get("Confirm Deletes"), "(absent)");
    EXPECT_EQ(rig.store.get("CB Band Qty"), "3");
}
