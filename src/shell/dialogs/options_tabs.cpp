// The six tabs of the options dialog: which control stands where, in which words.
#include "shell/dialogs/dialog_parts.h"
#include "shell/dialogs/number_field.h"
#include "shell/dialogs/options_dialog.h"
#include "shell/dialogs/sample_view.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGridLayout>
#include <QLineEdit>
#include <QSlider>
#include <QSpinBox>
#include <QVBoxLayout>

namespace {

constexpr int kFieldWidthPx = 110;  // of lists that hold a number

QVBoxLayout* column(std::initializer_list<QWidget*> widgets) {
    auto* layout = new QVBoxLayout;
    for (QWidget* widget : widgets)
        layout->addWidget(widget);
    layout->addStretch();
    return layout;
}

// The label is the field's buddy; the form layout sees to that.
template <typename Field>
Field* addRow(QFormLayout& layout, const QString& label, Field* field) {
    layout.addRow(label, field);
    field->setMinimumWidth(kFieldWidthPx);
    return field;
}

// Groups side by side share a row of the grid.
QWidget* tab(QGridLayout* grid) {
    auto* page = new QWidget;
    grid->setContentsMargins(kDialogGapPx, kDialogGapPx, kDialogGapPx, kDialogGapPx);
    grid->setSpacing(kDialogGapPx);
    page->setLayout(grid);
    return page;
}

}  // namespace

QWidget* frmZephOptions::tooltipsTab() {
    OptionControls& make = controls_;
    QCheckBox* chkShow = make.check("chkTTShowToolTips", tr("&Show a tooltip over the object under the pointer"),
                                    &ZephSettings::ToolTipsShow);
    QCheckBox* chkAlways =
        make.check("chkTTAlwaysShowFixture", tr("Show the &fixture's lines while props are selected, too"),
                   &ZephSettings::ToolTipsAlwaysShowFixture);

    auto* fixtures = new QGridLayout;
    fixtures->addWidget(make.check("chkTTName", tr("Name"), &ZephSettings::ToolTipsName), 0, 0);
    fixtures->addWidget(make.check("chkTTAsgnProp", tr("Prop it belongs to"), &ZephSettings::ToolTipsAsgnProp), 1, 0);
    fixtures->addWidget(make.check("chkTTComment", tr("Comment"), &ZephSettings::ToolTipsComment), 2, 0);
    fixtures->addWidget(make.check("chkTTType", tr("Type"), &ZephSettings::ToolTipsType), 3, 0);
    fixtures->addWidget(make.check("chkTTLevel", tr("Level"), &ZephSettings::ToolTipsLevel), 4, 0);
    fixtures->addWidget(make.check("chkTTPoints", tr("Number of points"), &ZephSettings::ToolTipsPoints), 0, 1);
    fixtures->addWidget(make.check("chkTTLock", tr("Lock"), &ZephSettings::ToolTipsLock), 1, 1);
    fixtures->addWidget(make.check("chkTTSize", tr("Bulb shape and size"), &ZephSettings::ToolTipsSize), 2, 1);
    fixtures->addWidget(make.check("chkTTOpacity", tr("Opacity"), &ZephSettings::ToolTipsOpacity), 3, 1);
    auto* channels = labelledForm();
    addRow(*channels, tr("&Channels listed:"),
           make.list("cmbTTNumberOfChannels", &ZephSettings::ToolTipsNumAsgnChannels));
    fixtures->addLayout(channels, 5, 0, 1, 2);
    fixtures->setRowStretch(6, 1);

    QVBoxLayout* props = column({make.check("chkTTPropName", tr("Name"), &ZephSettings::ToolTipsPropName),
                                 make.check("chkTTPropLock", tr("Lock"), &ZephSettings::ToolTipsPropLock),
                                 make.check("chkTTPropComment", tr("Comment"), &ZephSettings::ToolTipsPropComment)});
    auto* members = labelledForm();
    addRow(*members, tr("F&ixtures listed:"),
           make.list("cmbTTNumberOfFixtures", &ZephSettings::ToolTipsNumAsgnFixtures));
    props->insertLayout(3, members);

    QVBoxLayout* ribbons =
        column({make.check("chkTTKeshHardware", tr("Network and unit"), &ZephSettings::ToolTipsKeshHardware),
                make.check("chkTTKeshModes", tr("Unit and channel mode"), &ZephSettings::ToolTipsKeshModes),
                make.check("chkTTKeshResolution", tr("Resolution"), &ZephSettings::ToolTipsKeshResolution)});

    QSlider* sldPixelFlashSpeed = make.slider("sldPixelFlashSpeed", &ZephSettings::ToolTipsPixelFlash);
    sldPixelFlashSpeed->setTickPosition(QSlider::TicksBelow);
    sldPixelFlashSpeed->setTickInterval(4);
    lblPixelFlashSpeed_ = new QLabel;
    lblPixelFlashSpeed_->setObjectName("lblPixelFlashSpeed");
    lblPixelFlashSpeed_->setMinimumWidth(lblPixelFlashSpeed_->fontMetrics().horizontalAdvance("1000 ms"));
    lblPixelFlashSpeed_->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    connect(sldPixelFlashSpeed, &QSlider::valueChanged, this, &frmZephOptions::showPixelFlash);
    showPixelFlash(sldPixelFlashSpeed->value());
    auto* lblFlash = new QLabel(tr("Each &pixel shows for"));
    lblFlash->setBuddy(sldPixelFlashSpeed);
    auto* flash = new QHBoxLayout;
    flash->addWidget(lblFlash);
    flash->addWidget(sldPixelFlashSpeed, 1);
    flash->addWidget(lblPixelFlashSpeed_);

    QGroupBox* fixtureGroup = groupBox(tr("About a fixture"), fixtures);
    QGroupBox* propGroup = groupBox(tr("About a prop"), props);
    QGroupBox* ribbonGroup = groupBox(tr("About ribbons and pixels"), ribbons);
    for (QWidget* dependent : std::initializer_list<QWidget*>{chkAlways, fixtureGroup, propGroup, ribbonGroup})
        connect(chkShow, &QCheckBox::toggled, dependent, &QWidget::setEnabled);

    auto* grid = new QGridLayout;
    grid->addWidget(chkShow, 0, 0, 1, 2);
    grid->addWidget(chkAlways, 1, 0, 1, 2);
    grid->addWidget(fixtureGroup, 2, 0, 2, 1);
    grid->addWidget(propGroup, 2, 1);
    grid->addWidget(ribbonGroup, 3, 1);
    grid->addWidget(groupBox(tr("Order of pixels, shown with the Shift key down"), flash), 4, 0, 1, 2);
    grid->setColumnStretch(0, 3);
    grid->setColumnStretch(1, 2);
    grid->setRowStretch(3, 1);
    return tab(grid);
}

QWidget* frmZephOptions::generalTab() {
    OptionControls& make = controls_;
    auto* files = labelledForm();
    addRow(*files, tr("When the program s&tarts:"), make.list("cmbStartupOption", &ZephSettings::OnStartup));
    addRow(*files, tr("&Save automatically after:"), make.list("cmbAutoSave", &ZephSettings::AutoSave));
    files->addRow(make.check("chkCheckFileExtension", tr("Check the e&xtension of files"),
                             &ZephSettings::CheckFileExtension,
                             tr("Kept for other versions of the program; this one knows files by their content")));

    QVBoxLayout* editing = column(
        {make.check("chkConfirmDeletes", tr("&Ask before something is deleted"), &ZephSettings::ConfirmDeletes),
         make.check("chkEndStopsSimulation", tr("Closing the window during a simulation &ends the simulation only"),
                    &ZephSettings::EndStopsSimulation)});

    auto* display = new QGridLayout;
    auto* names = labelledForm();
    addRow(*names, tr("Show a fixture's &name at:"),
           make.list("cmbShowFixtureName", &ZephSettings::FixtureTextLocation));
    display->addLayout(names, 0, 0, 1, 2);
    display->addWidget(
        make.check("chkDisableFixtureText", tr("Hide the names of fixtures"), &ZephSettings::DisableFixtureText), 1, 0);
    display->addWidget(make.check("chkNoFixtureNamesDuringSelection", tr("Hide names while selecting"),
                                  &ZephSettings::NoFixtureNamesDuringSelection),
                       2, 0);
    display->addWidget(
        make.check("chkAlwaysShowPropNames", tr("Always show the names of props"), &ZephSettings::AlwaysShowPropNames),
        3, 0);
    display->addWidget(
        make.check("chkEditInColor", tr("Draw fixtures in their channels' colors"), &ZephSettings::EditInColor), 1, 1);
    display->addWidget(make.check("chkShowPixelOrder", tr("Show the order of pixels"), &ZephSettings::ShowPixelOrder),
                       2, 1);
    display->addWidget(
        make.check("chkSimplePropDisplay", tr("Show a prop as one row of the list"), &ZephSettings::SimplePropDisplay),
        3, 1);
    display->setColumnStretch(0, 1);
    display->setColumnStretch(1, 1);

    auto* grid = new QGridLayout;
    grid->addWidget(groupBox(tr("Files"), files), 0, 0);
    grid->addWidget(groupBox(tr("Editing"), editing), 1, 0);
    grid->addWidget(groupBox(tr("Display"), display), 2, 0);
    grid->setRowStretch(3, 1);
    return tab(grid);
}

QWidget* frmZephOptions::colorsTab() {
    OptionControls& make = controls_;
    const auto sampleChanged = [this] { showSample(); };
    cmdSampleBackgroundColor_ = make.color("cmdSampleBackgroundColor", tr("Background of the Sample"),
                                           &ZephSettings::SampleBackgroundColor, sampleChanged);
    cmdSampleRGBColor_ = make.color("cmdSampleRGBColor", tr("Color of RGB Fixtures in the Sample"),
                                    &ZephSettings::SampleRGBColor, sampleChanged);
    picSample_ = new SampleView;
    picSample_->setObjectName("picSample");
    auto* sampleColors = labelledForm();
    addRow(*sampleColors, tr("&Background:"), cmdSampleBackgroundColor_);
    addRow(*sampleColors, tr("RGB fi&xtures:"), cmdSampleRGBColor_);
    auto* sample = new QHBoxLayout;
    sample->setSpacing(2 * kDialogGapPx);
    sample->addLayout(sampleColors);
    sample->setAlignment(sampleColors, Qt::AlignTop);
    sample->addWidget(picSample_, 1);

    auto* colors = labelledForm();
    addRow(*colors, tr("&Names of fixtures:"),
           make.color("cmdFixtureTextColor", tr("Names of Fixtures"), &ZephSettings::FixtureTextColor));
    addRow(*colors, tr("&Tool handles:"),
           make.color("cmdToolHandleColor", tr("Tool Handles"), &ZephSettings::ToolHandleColor));
    addRow(*colors, tr("&Vertex handles:"),
           make.color("cmdVertexHandleColor", tr("Vertex Handles"), &ZephSettings::VertexHandleColor));
    addRow(*colors, tr("&Grid lines:"), make.color("cmdGridLineColor", tr("Grid Lines"), &ZephSettings::GridColor));

    auto* grid = new QGridLayout;
    grid->addWidget(groupBox(tr("Sample of a new fixture"), sample), 0, 0);
    grid->addWidget(groupBox(tr("Colors of the editor"), colors), 1, 0);
    grid->setRowStretch(2, 1);
    return tab(grid);
}

QWidget* frmZephOptions::newFixturesTab() {
    OptionControls& make = controls_;
    cmbAssumeNewObject_ = new QComboBox;
    cmbAssumeNewObject_->setObjectName("cmbAssumeNewObject");
    fillList(*cmbAssumeNewObject_, ZephAssumeNewObjectItems());
    auto* objects = labelledForm();
    addRow(*objects, tr("A drawing makes a &new fixture:"), cmbAssumeNewObject_);
    addRow(*objects, tr("Its channels are of &type:"),
           make.list("cmbDefaultChannelType", &ZephSettings::DefaultChannelType));
    objects->addRow(make.check("chkLEDDefault", tr("Its bulbs are &LED"), &ZephSettings::LEDDefault));

    auto* properties = new QGridLayout;
    properties->addWidget(
        make.check("chkPropertiesOnNewFixture", tr("a fixture was created"), &ZephSettings::PropertiesOnNewFixture), 0,
        0);
    properties->addWidget(
        make.check("chkPropertiesOnAddPoints", tr("points were added"), &ZephSettings::PropertiesOnAddPoints), 1, 0);
    properties->addWidget(
        make.check("chkPropertiesOnWizard", tr("a wizard made fixtures"), &ZephSettings::PropertiesOnWizardUse), 2, 0);
    properties->addWidget(make.check("chkPropertiesOnEditorSelect", tr("one was selected on the canvas"),
                                     &ZephSettings::PropertiesOnEditorSelect),
                          0, 1);
    properties->addWidget(make.check("chkPropertiesOnListSelect", tr("one was selected in the list"),
                                     &ZephSettings::PropertiesOnListSelect),
                          1, 1);
    properties->addWidget(make.check("chkPropertiesOnObjectUndo", tr("a change was undone or redone"),
                                     &ZephSettings::PropertiesOnObjectUndo,
                                     tr("Kept for other versions of the program; this one shows nothing then")),
                          2, 1);
    properties->setColumnStretch(0, 1);
    properties->setColumnStretch(1, 1);

    QVBoxLayout* names =
        column({make.check("chkFixtureNameAsChannelName", tr("the &fixture's name"), &ZephSettings::ChannelDefaultName),
                make.check("chkChannelNumberAsChannelName", tr("the &channel's number"),
                           &ZephSettings::ChannelDefaultOrderNum),
                make.check("chkRGBColorAsChannelName", tr("the c&olor's name, for RGB"),
                           &ZephSettings::ChannelDefaultRGBColor)});

    auto* grid = new QGridLayout;
    grid->addWidget(groupBox(tr("New fixtures"), objects), 0, 0);
    grid->addWidget(groupBox(tr("Open the properties after"), properties), 1, 0);
    grid->addWidget(groupBox(tr("A new channel's name is made of"), names), 2, 0);
    grid->setRowStretch(3, 1);
    return tab(grid);
}

QWidget* frmZephOptions::bulbsTab() {
    OptionControls& make = controls_;
    auto* bulbs = labelledForm();
    addRow(*bulbs, tr("&Size of bulbs:"), make.list("cmbBulbSize", &ZephSettings::BulbSize));
    addRow(*bulbs, tr("S&pacing of bulbs:"), make.list("cmbBulbSpacing", &ZephSettings::BulbSpacing));
    addRow(*bulbs, tr("S&hape of bulbs:"), make.list("cmbBulbShape", &ZephSettings::BulbShape));
    QComboBox* cmbKeshBulbShape =
        addRow(*bulbs, tr("Shape on ribbons:"), make.list("cmbKeshBulbShape", &ZephSettings::KeshBulbShape));
    cmbKeshBulbShape->setEnabled(false);
    cmbKeshBulbShape->setToolTip(tr("Ribbons always show the pixel bulb"));
    auto* floods = labelledForm();
    addRow(*floods, tr("Size of &floods:"), make.list("cmbFloodSize", &ZephSettings::FloodSize));
    addRow(*floods, tr("&Opacity of floods:"), make.list("cmbMaxOpacity", &ZephSettings::FloodOpacity));
    addRow(*floods, tr("&Level:"), make.list("cmbZOrder", &ZephSettings::ZOrder));
    auto* defaults = new QHBoxLayout;
    defaults->addLayout(bulbs, 1);
    defaults->addLayout(floods, 1);

    QVBoxLayout* warnings = column(
        {make.check("chkBulbSizeWarning", tr("&bulbs too small for their shape"), &ZephSettings::BulbSizeWarning),
         make.check("chkKeshBulbCountWarning", tr("a ribbon with a wrong &number of pixels"),
                    &ZephSettings::KeshBulbCountWarning),
         make.check("chkBackgroundWarning", tr("a fault of the back&ground picture"), &ZephSettings::BackgroundWarning),
         make.check("chkCorruptedFileWarning", tr("a file &changed by another program"),
                    &ZephSettings::NoCorruptFileWarning,
                    tr("Kept for other versions of the program; this one never warns of it"))});

    auto* grid = new QGridLayout;
    grid->addWidget(groupBox(tr("What new fixtures begin with"), defaults), 0, 0);
    grid->addWidget(groupBox(tr("Do not warn of"), warnings), 1, 0);
    grid->setRowStretch(2, 1);
    return tab(grid);
}

QWidget* frmZephOptions::communicationsTab() {
    OptionControls& make = controls_;
    txtZephPort_ = new QLineEdit;
    txtZephPort_->setObjectName("txtZephPort");
    txtZephPort_->setValidator(new DigitsOnly(txtZephPort_));
    txtZephPort_->setMaximumWidth(kFieldWidthPx);
    cmbAdapter_ = new QComboBox;
    cmbAdapter_->setObjectName("cmbAdapter");
    cmbAdapter_->setSizeAdjustPolicy(QComboBox::AdjustToContents);
    fillList(*cmbAdapter_, ZephAdapterItems(adapters_));
    connect(cmbAdapter_, &QComboBox::currentIndexChanged, this, &frmZephOptions::cmbAdapter_Click);
    lblLocalIP_ = new QLabel;
    lblLocalIP_->setObjectName("lblLocalIP");
    lblLocalIP_->setTextFormat(Qt::PlainText);
    lblLocalIP_->setTextInteractionFlags(Qt::TextSelectableByMouse);
    chkUseTCP_ = new QCheckBox(tr("Receive over &TCP until the program ends; it starts with UDP"));
    chkUseTCP_->setObjectName("chkUseTCP");
    auto* link = labelledForm();
    addRow(*link, tr("Simulation &port:"), txtZephPort_);
    addRow(*link, tr("Network &adapter:"), cmbAdapter_);
    link->addRow(QString(), lblLocalIP_);
    link->addRow(QString(), chkUseTCP_);

    auto* rendering = labelledForm();
    rendering->addRow(make.check("chkAdvancedRendering", tr("Use the ad&vanced render engine (OpenGL)"),
                                 &ZephSettings::AdvancedRenderEngine));
    rendering->addRow(make.check("chkForceForward", tr("Bring the simulation to the &front when a sequence starts"),
                                 &ZephSettings::ForceSimulationForward));
    QSpinBox* numStrobeFireTime = addRow(*rendering, tr("A &strobe flashes for:"),
                                         make.number("numStrobeFireTime", &ZephSettings::StrobeFireTime));
    numStrobeFireTime->setSuffix(tr(" ms"));

    QVBoxLayout* references =
        column({make.check("chkReferenceReminder", tr("Do not offer to &load another reference file"),
                           &ZephSettings::ReferenceFileWarning)});

    auto* grid = new QGridLayout;
    grid->addWidget(groupBox(tr("Data link"), link), 0, 0);
    grid->addWidget(groupBox(tr("Simulation"), rendering), 1, 0);
    grid->addWidget(groupBox(tr("References"), references), 2, 0);
    grid->setRowStretch(3, 1);
    return tab(grid);
}
