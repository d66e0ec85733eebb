#include "shell/dialogs/options_dialog.h"
#include "shell/edit_options.h"
#include "tests/shell/controls.h"
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
#include <QTimer>

namespace {

struct OptionsDialog : testing::Test, Controls, SettingsRig {
    OptionsDialog() {
        store.set("Adapter To Use", "Stage");
        EXPECT_TRUE(read());
    }
    // Makes and shows the dialog on what the test has set up.
    void open() {
        const auto pick = [this](std::int32_t, const QString&, QWidget*) { return picked; };
        own = std::make_unique<frmZephOptions>(ZephOptionsDraftOf(settings, connection), adapters,
                                               OptionsDesk{host, [] {}, pick});
        dialog = own.get();
        dialog->show();
    }
    // Opens the dialog as the menu does and works it from inside its own event loop.
    OptionsOutcome edit(const std::function<void()>& work) {
        QTimer::singleShot(0, [&] {
            dialog = dynamic_cast<frmZephOptions*>(QApplication::activeModalWidget());
            ASSERT_NE(dialog, nullptr);
            work();
            if (dialog->isVisible()) dialog->reject();
        });
        return ZephEditOptions(context, nullptr, settings, connection, adapters);
    }
    QWidget& shown() override { return *dialog; }
    void choose(const char* name, const QString& text) {
        auto* box = find<QComboBox>(name);
        ASSERT_GE(box->findText(text), 0) << name;
        box->setCurrentIndex(box->findText(text));
    }
    bool accepted() const { return dialog->result() == QDialog::Accepted && !dialog->isVisible(); }

    std::optional<std::int32_t> picked;
    std::unique_ptr<frmZephOptions> own;
    frmZephOptions* dialog = nullptr;
};

}  // namespace

TEST_F(OptionsDialog, OkWithoutAChangeGivesTheSettingsBackAsTheyWere) {
    settings.AutoSave = 7;  // in the store by another hand: no list offers it
    settings.ZOrder = 0;
    settings.FloodOpacity = 52;
    settings.LastOptsTab = 3;
    open();
    EXPECT_EQ(find<QTabWidget>("tabOptions")->currentIndex(), 3);
    EXPECT_EQ(find<QComboBox>("cmbAutoSave")->placeholderText(), "7 Minutes");
    EXPECT_EQ(find<QComboBox>("cmbMaxOpacity")->placeholderText(), "52 %");
    EXPECT_FALSE(find<QComboBox>("cmbKeshBulbShape")->isEnabled());
    EXPECT_EQ(find<QComboBox>("cmbKeshBulbShape")->currentText(), "Pixel Bulb");
    click("cmdToolHandleColor");  // the color dialog is left without a choice
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
    EXPECT_EQ(find<QPushButton>("cmdFixtureTextColor")->text(), "#030201");  // of a number in which blue stands highest
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
    const Connection& link = dialog->draft().Link;
    EXPECT_EQ(std::tie(link.ZephAdapterName, link.ZephAdapterIP, link.ZephSimulationPort, link.ZephUseTCP),
              std::make_tuple("Local", "127.0.0.1", 4000, true));
}

TEST_F(OptionsDialog, AnAdapterShowsItsAddressAndAWrongPortLeadsToItsField) {
    connection = {"Gone", "127.0.0.1", 0, false, false};
    open();
    ASSERT_TRUE(QTest::qWaitForWindowActive(dialog));
    click("cmdOK");
    EXPECT_TRUE(dialog->isVisible());
    EXPECT_EQ(host.boxes.size(), 1u);
    EXPECT_EQ(find<QTabWidget>("tabOptions")->currentIndex(), 5);
    EXPECT_EQ(QApplication::focusWidget(), find<QLineEdit>("txtZephPort"));

    EXPECT_EQ(find<QComboBox>("cmbAdapter")->placeholderText(), "Gone");
    EXPECT_EQ(find<QLabel>("lblLocalIP")->text(), "IP address: 127.0.0.1");
    choose("cmbAdapter", "Spare");
    EXPECT_EQ(find<QLabel>("lblLocalIP")->text(), "IP address: 0.0.0.0");
    choose("cmbAdapter", "Stage");
    QTest::keyClicks(find<QLineEdit>("txtZephPort"), "65535");
    click("cmdOK");
    EXPECT_TRUE(accepted());
}

TEST_F(OptionsDialog, StoresAtOnceWhatWasAccepted) {
    connection.ZephPortOpen = true;
    machine.pop_back();
    const OptionsOutcome outcome = edit([this] {
        EXPECT_EQ(find<QComboBox>("cmbAdapter")->count(), 2);  // listed anew
        find<QCheckBox>("chkUseTCP")->setChecked(true);
        find<QCheckBox>("chkConfirmDeletes")->setChecked(false);
        click("cmdOK");
    });
    EXPECT_EQ(outcome, OptionsOutcome::Stored);
    EXPECT_FALSE(settings.ConfirmDeletes);
    EXPECT_TRUE(connection.ZephUseTCP);  // for the rest of this run
    EXPECT_TRUE(connection.ZephPortOpen);
    EXPECT_EQ(store.get("Confirm Deletes"), "False");
    EXPECT_EQ(store.get("ShutDownTime"), "(absent)");
    EXPECT_EQ(host.boxes.size(), 1u);
}

TEST_F(OptionsDialog, AResetReachesStoreSettingsAndConnection) {
    settings.ConfirmDeletes = false;
    settings.RecentFiles[0] = "/a.zee";
    connection.ZephSimulationPort = 4000;
    write();
    const ZephSettings before = settings;
    const auto cancel = [this] {
        find<QCheckBox>("chkEditInColor")->toggle();
        click("cmdCancel");
    };
    EXPECT_EQ(edit(cancel), OptionsOutcome::Kept);
    EXPECT_EQ(settings, before);
    host.answers = {BoxAnswer::Cancel, BoxAnswer::Ok};
    const auto resetTwice = [this] {
        click("cmdReset");
        EXPECT_TRUE(dialog->isVisible());
        click("cmdReset");
    };
    EXPECT_EQ(edit(resetTwice), OptionsOutcome::Reset);
    EXPECT_TRUE(settings.ConfirmDeletes);
    EXPECT_EQ(settings.RecentFiles[0], "");
    EXPECT_EQ(connection.ZephSimulationPort, 30303);
    EXPECT_EQ(store.get("Confirm Deletes"), "(absent)");
    EXPECT_EQ(store.get("CB Band Qty"), "3");
    const std::string asked = "Qen Visualizer-Reset Options to Defaults?|Are you sure you want to reset all options to "
                              "defaults?\r\nNote: This operation will reset your entire environment\r\nincluding "
                              "editor colors, recent files, toolbar locations, etc\n";
    EXPECT_EQ(host.boxTexts(),
              asked + asked + "Qen Visualizer-Reset Options to Defaults|All options reset to defaults");
}
