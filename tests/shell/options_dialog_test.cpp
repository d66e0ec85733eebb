#include "shell/dialogs/options_dialog.h"
#include "shell/edit_options.h"
#include "tests/shell/settings_rig.h"

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QSlider>
#include <QSpinBox>
#include <QTabWidget>
#include <QTest>
#include <QTimer>

namespace {

struct OptionsDialog : testing::Test {
    OptionsDialog() {
        adapters[1] = {"Local", "127.0.0.1"};
        adapters[2] = {"Stage", "192.168.1.20"};
        adapters[3] = {"Spare", "0.0.0.0"};
        link = {"Stage", "192.168.1.20", 30303, false, false};
        settings.AdapterToUse = "Stage";
    }
    // Makes and shows the dialog on what the test has set up.
    void open() {
        const auto pick = [this](std::int32_t, const QString&, QWidget*) { return picked; };
        const OptionsDesk desk{host, [this] { ++resets; }, pick};
        dialog = std::make_unique<frmZephOptions>(ZephOptionsDraftOf(settings, link), adapters, desk);
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

    RecordingHost host;
    ZephSettings settings;
    Connection link;
    ZephAdapters adapters;
    std::optional<std::int32_t> picked;
    int resets = 0;
    std::unique_ptr<frmZephOptions> dialog;
};

// Every control that stands for one setting.
struct Check {
    const char* name;
    FlagField field;
};
// clang-format off
constexpr auto kChecks = std::to_array<Check>({
    {"chkTTShowToolTips", &ZephSettings::ToolTipsShow},
    {"chkTTAlwaysShowFixture", &ZephSettings::ToolTipsAlwaysShowFixture},
    {"chkTTAsgnProp", &ZephSettings::ToolTipsAsgnProp}, {"chkTTKeshHardware", &ZephSettings::ToolTipsKeshHardware},
    {"chkTTKeshModes", &ZephSettings::ToolTipsKeshModes},
    {"chkTTKeshResolution", &ZephSettings::ToolTipsKeshResolution}, {"chkTTComment", &ZephSettings::ToolTipsComment},
    {"chkTTLevel", &ZephSettings::ToolTipsLevel}, {"chkTTLock", &ZephSettings::ToolTipsLock},
    {"chkTTName", &ZephSettings::ToolTipsName}, {"chkTTOpacity", &ZephSettings::ToolTipsOpacity},
    {"chkTTPoints", &ZephSettings::ToolTipsPoints}, {"chkTTPropComment", &ZephSettings::ToolTipsPropComment},
    {"chkTTPropLock", &ZephSettings::ToolTipsPropLock}, {"chkTTPropName", &ZephSettings::ToolTipsPropName},
    {"chkTTSize", &ZephSettings::ToolTipsSize}, {"chkTTType", &ZephSettings::ToolTipsType},
    {"chkConfirmDeletes", &ZephSettings::ConfirmDeletes}, {"chkLEDDefault", &ZephSettings::LEDDefault},
    {"chkPropertiesOnNewFixture", &ZephSettings::PropertiesOnNewFixture},
    {"chkPropertiesOnEditorSelect", &ZephSettings::PropertiesOnEditorSelect},
    {"chkPropertiesOnListSelect", &ZephSettings::PropertiesOnListSelect},
    {"chkPropertiesOnAddPoints", &ZephSettings::PropertiesOnAddPoints},
    {"chkPropertiesOnObjectUndo", &ZephSettings::PropertiesOnObjectUndo},
    {"chkPropertiesOnWizard", &ZephSettings::PropertiesOnWizardUse},
    {"chkAlwaysShowPropNames", &ZephSettings::AlwaysShowPropNames},
    {"chkSimplePropDisplay", &ZephSettings::SimplePropDisplay},
    {"chkReferenceReminder", &ZephSettings::ReferenceFileWarning},
    {"chkBulbSizeWarning", &ZephSettings::BulbSizeWarning},
    {"chkKeshBulbCountWarning", &ZephSettings::KeshBulbCountWarning}, {"chkEditInColor", &ZephSettings::EditInColor},
    {"chkShowPixelOrder", &ZephSettings::ShowPixelOrder}, {"chkBackgroundWarning", &ZephSettings::BackgroundWarning},
    {"chkEndStopsSimulation", &ZephSettings::EndStopsSimulation},
    {"chkCorruptedFileWarning", &ZephSettings::NoCorruptFileWarning},
    {"chkDisableFixtureText", &ZephSettings::DisableFixtureText},
    {"chkCheckFileExtension", &ZephSettings::CheckFileExtension},
    {"chkForceForward", &ZephSettings::ForceSimulationForward},
    {"chkAdvancedRendering", &ZephSettings::AdvancedRenderEngine}, {"chkUseTCP", &ZephSettings::UseTCP},
    {"chkFixtureNameAsChannelName", &ZephSettings::ChannelDefaultName},
    {"chkChannelNumberAsChannelName", &ZephSettings::ChannelDefaultOrderNum},
    {"chkRGBColorAsChannelName", &ZephSettings::ChannelDefaultRGBColor},
    {"chkNoFixtureNamesDuringSelection", &ZephSettings::NoFixtureNamesDuringSelection},
});
// clang-format on

struct Choice {
    const char* name;
    const char* text;
    LongField field;
    std::int32_t value;
};
constexpr std::array kChoices{
    Choice{"cmbStartupOption", "Automatically Open Last File", &ZephSettings::OnStartup, 2},
    Choice{"cmbAutoSave", "2 Hours", &ZephSettings::AutoSave, 120},
    Choice{"cmbDefaultChannelType", "RGB", &ZephSettings::DefaultChannelType, 2},
    Choice{"cmbShowFixtureName", "Pixel Num ONLY", &ZephSettings::FixtureTextLocation, 7},
    Choice{"cmbBulbSize", "16", &ZephSettings::BulbSize, 16},
    Choice{"cmbBulbSpacing", "0", &ZephSettings::BulbSpacing, 0},
    Choice{"cmbFloodSize", "64", &ZephSettings::FloodSize, 64},
    Choice{"cmbMaxOpacity", "5 %", &ZephSettings::FloodOpacity, 5},
    Choice{"cmbZOrder", "16", &ZephSettings::ZOrder, 16},
    Choice{"cmbTTNumberOfChannels", "(none)", &ZephSettings::ToolTipsNumAsgnChannels, 0},
    Choice{"cmbTTNumberOfFixtures", "63", &ZephSettings::ToolTipsNumAsgnFixtures, 63},
    Choice{"cmbBulbShape", "8 Point Star", &ZephSettings::BulbShape, 10},
};

struct Swatch {
    const char* name;
    LongField field;
};
constexpr std::array kSwatches{
    Swatch{"cmdFixtureTextColor", &ZephSettings::FixtureTextColor},
    Swatch{"cmdToolHandleColor", &ZephSettings::ToolHandleColor},
    Swatch{"cmdVertexHandleColor", &ZephSettings::VertexHandleColor},
    Swatch{"cmdGridLineColor", &ZephSettings::GridColor},
    Swatch{"cmdSampleBackgroundColor", &ZephSettings::SampleBackgroundColor},
    Swatch{"cmdSampleRGBColor", &ZephSettings::SampleRGBColor},
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
    ZephSettings wanted = settings;
    open();
    for (const Check& each : kChecks) {
        find<QCheckBox>(each.name)->toggle();
        wanted.*each.field = !(settings.*each.field);
    }
    for (const Choice& each : kChoices) {
        choose(each.name, each.text);
        wanted.*each.field = each.value;
    }
    for (std::int32_t color = 0x010203; const Swatch& each : kSwatches) {
        picked = color;
        click(each.name);
        wanted.*each.field = color++;
    }
    choose("cmbAssumeNewObject", "Always");
    wanted.AssumeNewObject = true;
    choose("cmbAdapter", "Local");
    wanted.AdapterToUse = "Local";
    find<QSlider>("sldPixelFlashSpeed")->setValue(25);
    wanted.ToolTipsPixelFlash = 25;
    EXPECT_EQ(find<QLabel>("lblPixelFlashSpeed")->text(), "1000 ms");
    find<QSpinBox>("numStrobeFireTime")->setValue(100);
    wanted.StrobeFireTime = 100;
    find<QTabWidget>("tabOptions")->setCurrentIndex(5);
    wanted.LastOptsTab = 5;
    find<QLineEdit>("txtZephPort")->setFocus();
    find<QLineEdit>("txtZephPort")->selectAll();
    QTest::keyClicks(find<QLineEdit>("txtZephPort"), "4a-0 .00x");
    wanted.SimulationPort = 4000;
    click("cmdOK");
    ASSERT_TRUE(accepted());
    EXPECT_EQ(dialog->draft().Settings, wanted);
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
    link.ZephSimulationPort = 0;
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
    link.ZephAdapterName = "Gone";
    link.ZephAdapterIP = "127.0.0.1";
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
