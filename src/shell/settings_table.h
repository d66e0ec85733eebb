// The table of the settings: one row for each, in the order in which they are read and written. Reading, writing,
// resetting and the ranges that the options dialog offers all go by it. Defaults stand in the record.
#pragma once

#include "model/settings.h"
#include "model/tables.h"
#include "util/failure.h"

#include <array>
#include <cstdint>
#include <limits>
#include <string_view>
#include <variant>

using LongField = std::int32_t ZephSettings::*;
using FlagField = bool ZephSettings::*;
using TextField = std::string ZephSettings::*;

enum class SettingRule {
    Plain,           // what lies outside the range reads as the default
    LeastIfOutside,  // ... as the least value: a window made too small stays small
    StartsFalse,     // read and dropped: every run starts with false
    StoredPath,      // a path, kept in its stored form
};

struct SettingRow {
    std::string_view Name;
    std::variant<LongField, FlagField, TextField> Field;
    std::int32_t Min = 0;  // of a long
    std::int32_t Max = 0;
    SettingRule Rule = SettingRule::Plain;
};

inline constexpr std::int32_t kNoLimit = std::numeric_limits<std::int32_t>::max();

// clang-format off
inline constexpr auto kSettings = std::to_array<SettingRow>({
    // Window and general numbers
    {"Left", &ZephSettings::Left, 0, kNoLimit},
    {"Top", &ZephSettings::Top, 0, kNoLimit},
    {"Width", &ZephSettings::Width, 2100, kNoLimit, SettingRule::LeastIfOutside},
    {"Height", &ZephSettings::Height, 2950, kNoLimit, SettingRule::LeastIfOutside},
    {"State", &ZephSettings::State, 0, 2},
    {"On Startup", &ZephSettings::OnStartup, 0, 2},
    {"Bulb Size", &ZephSettings::BulbSize, 1, kMaxBulbSize},
    {"Bulb Spacing", &ZephSettings::BulbSpacing, 0, 64},
    {"Bulb Shape", &ZephSettings::BulbShape, 1, kBulbShapes},
    {"Kesh Bulb Shape", &ZephSettings::KeshBulbShape, kBulbShapes, kBulbShapes},
    {"Flood Size", &ZephSettings::FloodSize, 1, kMaxFloodSize},
    {"Flood Opacity", &ZephSettings::FloodOpacity, 5, 100},
    {"ZOrder", &ZephSettings::ZOrder, 0, 16},
    {"Auto Save", &ZephSettings::AutoSave, 0, kNoLimit},
    {"Show Grid", &ZephSettings::ShowGrid, 0, 4},
    {"Grid Density", &ZephSettings::GridDensity, 1, 20},
    {"Grid Color", &ZephSettings::GridColor, 0, 16777215},
    {"Fixture Text Color", &ZephSettings::FixtureTextColor, 0, kNoLimit},
    {"Tool Handle Color", &ZephSettings::ToolHandleColor, 0, kNoLimit},
    {"Vertex Handle Color", &ZephSettings::VertexHandleColor, 0, kNoLimit},
    {"Sample Background Color", &ZephSettings::SampleBackgroundColor, 0, kNoLimit},
    {"Sample RGB Color", &ZephSettings::SampleRGBColor, 0, kNoLimit},
    {"Default Channel Type", &ZephSettings::DefaultChannelType, 1, 2},
    {"Fixture Text Location", &ZephSettings::FixtureTextLocation, 0, 7},
    {"Last Opts Tab", &ZephSettings::LastOptsTab, 0, 5},
    {"Simulation Port", &ZephSettings::SimulationPort, 0, 65535},
    {"Strobe Fire Time", &ZephSettings::StrobeFireTime, 0, 100},
    {"Draw Pixel Qty", &ZephSettings::DrawPixelQty, 2, 500},
    {"ToolTips PixelFlash", &ZephSettings::ToolTipsPixelFlash, 1, 25},
    {"ToolTips NumAsgnChannels", &ZephSettings::ToolTipsNumAsgnChannels, 0, 16},
    {"ToolTips NumAsgnFixtures", &ZephSettings::ToolTipsNumAsgnFixtures, 0, 64},
    // General flags
    {"Confirm Deletes", &ZephSettings::ConfirmDeletes},
    {"LED Default", &ZephSettings::LEDDefault},
    {"Properties On New Fixture", &ZephSettings::PropertiesOnNewFixture},
    {"Properties On Editor Select", &ZephSettings::PropertiesOnEditorSelect},
    {"Properties On List Select", &ZephSettings::PropertiesOnListSelect},
    {"Properties On Add Points", &ZephSettings::PropertiesOnAddPoints},
    {"Properties On Object Undo", &ZephSettings::PropertiesOnObjectUndo},
    {"Properties On Wizard Use", &ZephSettings::PropertiesOnWizardUse},
    {"Assume New Object", &ZephSettings::AssumeNewObject},
    {"Always Show Prop Names", &ZephSettings::AlwaysShowPropNames},
    {"Simple Prop Display", &ZephSettings::SimplePropDisplay},
    {"Reference File Warning", &ZephSettings::ReferenceFileWarning},
    {"Bulb Size Warning", &ZephSettings::BulbSizeWarning},
    {"Kesh Bulb Count Warning", &ZephSettings::KeshBulbCountWarning},
    {"Edit In Color", &ZephSettings::EditInColor},
    {"Show Pixel Order", &ZephSettings::ShowPixelOrder},
    {"Background Warning", &ZephSettings::BackgroundWarning},
    {"End Stops Simulation", &ZephSettings::EndStopsSimulation},
    {"No Corrupt File Warning", &ZephSettings::NoCorruptFileWarning},
    {"Disable Fixture Text", &ZephSettings::DisableFixtureText},
    {"Check File Extension", &ZephSettings::CheckFileExtension},
    {"Force Simulation Forward", &ZephSettings::ForceSimulationForward},
    {"Advanced Render Engine", &ZephSettings::AdvancedRenderEngine},
    {"Use TCP", &ZephSettings::UseTCP, 0, 0, SettingRule::StartsFalse},
    {"Channel Default Name", &ZephSettings::ChannelDefaultName},
    {"Channel Default Order Num", &ZephSettings::ChannelDefaultOrderNum},
    {"Channel Default RGB Color", &ZephSettings::ChannelDefaultRGBColor},
    {"No Fixture Names During Selection", &ZephSettings::NoFixtureNamesDuringSelection},
    // What the wizards were last given
    {"Arch Wizard Type", &ZephSettings::ArchWizardType, 0, 1},
    {"Arch Wizard Size", &ZephSettings::ArchWizardSize, 10, 100},
    {"Arch Wizard First Location", &ZephSettings::ArchWizardFirstLocation, 0, 1},
    {"Arch Wizard Segments", &ZephSettings::ArchWizardSegments, 1, 64},
    {"Arch Wizard Channel Type", &ZephSettings::ArchWizardChannelType, 0, 2},
    {"Arch Wizard Pixels Per Segment", &ZephSettings::ArchWizardPixelsPerSegment, 2, 50},
    {"Arch Wizard Fill Density", &ZephSettings::ArchWizardFillDensity, 1, 10},
    {"Tree Wizard Size", &ZephSettings::TreeWizardSize, 25, 150},
    {"Tree Wizard Top Size", &ZephSettings::TreeWizardTopSize, 0, 150},
    {"Tree Wizard XRot", &ZephSettings::TreeWizardXRot, 0, 180},
    {"Tree Wizard YRot", &ZephSettings::TreeWizardYRot, -89, 89},
    {"Tree Wizard Height", &ZephSettings::TreeWizardHeight, 25, 150},
    {"Tree Wizard Type", &ZephSettings::TreeWizardType, 0, 1},
    {"Tree Wizard Bundle Type", &ZephSettings::TreeWizardBundleType, 0, 12},
    {"Tree Wizard First Location", &ZephSettings::TreeWizardFirstLocation, 0, 1},
    {"Tree Wizard Number of Bundles", &ZephSettings::TreeWizardNumberOfBundles, 4, 64},
    {"Tree Wizard Consecutive Bundles", &ZephSettings::TreeWizardConsecutiveBundles, 1, 32},
    {"Tree Wizard Channel Type", &ZephSettings::TreeWizardChannelType, 0, 1},
    {"Tree Wizard Pixels Per Segment", &ZephSettings::TreeWizardPixelsPerSegment, 2, 170},
    {"Matrix Wizard Bulb Size", &ZephSettings::MatrixWizardBulbSize, 1, 16},
    {"Matrix Wizard Channel Type", &ZephSettings::MatrixWizardChannelType, 1, 2},
    {"Matrix Wizard Horiz Spacing", &ZephSettings::MatrixWizardHorizSpacing, 1, 50},
    {"Matrix Wizard Vert Spacing", &ZephSettings::MatrixWizardVertSpacing, 1, 50},
    {"Matrix Wizard Pixel Height", &ZephSettings::MatrixWizardPixelHeight, 1, 170},
    {"Matrix Wizard Pixel Width", &ZephSettings::MatrixWizardPixelWidth, 1, 170},
    {"Matrix Wizard Orientation", &ZephSettings::MatrixWizardOrientation, 0, 1},
    {"Matrix Wizard Origin", &ZephSettings::MatrixWizardOrigin, 0, 3},
    {"Arch Wizard Option Fill Fan", &ZephSettings::ArchWizardOptionFillFan},
    {"Arch Wizard Center to Edge", &ZephSettings::ArchWizardCenterToEdge},
    {"Arch Wizard Correct Arch", &ZephSettings::ArchWizardCorrectArch},
    {"Tree Wizard Option CC", &ZephSettings::TreeWizardOptionCC},
    {"Tree Wizard Option Base Lights", &ZephSettings::TreeWizardOptionBaseLights},
    {"Matrix Wizard Snake Pattern", &ZephSettings::MatrixWizardSnakePattern},
    {"Matrix Wizard Show Flow", &ZephSettings::MatrixWizardShowFlow},
    // Lines of the object tip
    {"ToolTips Show", &ZephSettings::ToolTipsShow},
    {"ToolTips Always Show Fixture", &ZephSettings::ToolTipsAlwaysShowFixture},
    {"ToolTips Asgn Prop", &ZephSettings::ToolTipsAsgnProp},
    {"ToolTips Kesh Hardware", &ZephSettings::ToolTipsKeshHardware},
    {"ToolTips Kesh Modes", &ZephSettings::ToolTipsKeshModes},
    {"ToolTips Kesh Resolution", &ZephSettings::ToolTipsKeshResolution},
    {"ToolTips Comment", &ZephSettings::ToolTipsComment},
    {"ToolTips Level", &ZephSettings::ToolTipsLevel},
    {"ToolTips Lock", &ZephSettings::ToolTipsLock},
    {"ToolTips Name", &ZephSettings::ToolTipsName},
    {"ToolTips Opacity", &ZephSettings::ToolTipsOpacity},
    {"ToolTips Points", &ZephSettings::ToolTipsPoints},
    {"ToolTips PropComment", &ZephSettings::ToolTipsPropComment},
    {"ToolTips PropLock", &ZephSettings::ToolTipsPropLock},
    {"ToolTips PropName", &ZephSettings::ToolTipsPropName},
    {"ToolTips Size", &ZephSettings::ToolTipsSize},
    {"ToolTips Type", &ZephSettings::ToolTipsType},
    // Text
    {"Adapter To Use", &ZephSettings::AdapterToUse},
    {"Last Fixture File", &ZephSettings::LastFixtureFile, 0, 0, SettingRule::StoredPath},
    {"Last Prop File", &ZephSettings::LastPropFile, 0, 0, SettingRule::StoredPath},
});
// clang-format on

struct SettingRange {
    std::int32_t Min;
    std::int32_t Max;
};

// The range of a number's row. Throws Failure for a field without a row, which no caller names.
constexpr SettingRange settingRange(LongField field) {
    for (const SettingRow& row : kSettings) {
        const LongField* own = std::get_if<LongField>(&row.Field);
        if (own != nullptr && *own == field) return {row.Min, row.Max};
    }
    throwFailure("this number has no row in the table of settings", SourceLine::current());
}

static_assert(
    [] {
        const ZephSettings defaults;
        for (const SettingRow& row : kSettings) {
            const LongField* field = std::get_if<LongField>(&row.Field);
            if (field == nullptr) continue;
            if (defaults.**field < row.Min || defaults.**field > row.Max) return false;
        }
        return true;
    }(),
    "a default lies outside its own range");
