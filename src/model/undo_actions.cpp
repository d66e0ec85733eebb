#include "model/undo_actions.h"

#include "model/document.h"
#include "model/ui_state.h"

#include <utility>

namespace {

using enum UndoName;

constexpr std::array<UndoActionRow, 36> kRows{{
    {kUndoDeletedFixture, "Deleted ", Fixture, 0},
    {kUndoInsertedFixture, "Inserted Fixture ", Fixture, 0},
    {kUndoInsertedSymbol, "Inserted Symbol ", Fixture, 0},
    {kUndoEndDrawing, "End Drawing of ", Fixture, 0},
    {kUndoAddedPoints, "Added Points to ", Fixture, 0},
    {kUndoCut, "Cut ", Fixture, 0},
    {kUndoPasted, "Pasted ", Fixture, 0},
    {kUndoFixtureProperties, "Properties Change Of ", Fixture, kStateSelectFixture},
    {kUndoChanged, "Changed ", Fixture, 0},
    {kUndoSentHome, "Sent Home ", Fixture, 0},
    {kUndoSentToForeground, "Sent to Foreground ", Fixture, kStateSelectFixture},
    {kUndoSentToBackground, "Sent to Background ", Fixture, kStateSelectFixture},
    {kUndoMovedForward, "Changed Z Order ", Fixture, kStateSelectFixture},
    {kUndoMovedBackward, "Changed Z Order ", Fixture, kStateSelectFixture},
    {kUndoLockedFixture, "Locked Fixture ", Fixture, kStateSelectFixture},
    {kUndoUnlockedFixture, "UnLocked Fixture ", Fixture, kStateSelectFixture},
    {kUndoCreatedProp, "Created Prop Name ", Prop, 0},
    {kUndoDeletedProp, "Deleted Prop Name ", Prop, 0},
    {kUndoPropProperties, "Changed Prop ", Prop, kStateSelectProp},
    {kUndoDeletedPropOfFixture, "Deleted ", PropOfFixture, 0},
    {kUndoCutProp, "Cut ", PropOfFixture, 0},
    {kUndoInsertedProp, "Inserted Prop ", PropOfFixture, 0},
    {kUndoPastedProp, "Pasted ", PropOfFixture, 0},
    {kUndoChangedProp, "Changed ", PropOfFixture, 0},
    {kUndoSentPropHome, "Sent Home ", PropOfFixture, 0},
    {kUndoLockedProp, "Locked Prop ", Prop, kStateSelectProp},
    {kUndoUnlockedProp, "Unlocked Prop ", Prop, kStateSelectProp},
    {kUndoKeshWizard, "Ran Kesh Wizard - ", Comment, 0},
    {kUndoTreeWizard, "Ran Mega Tree Wizard - ", Comment, 0},
    {kUndoArchWizard, "Ran Arch Wizard - ", Comment, 0},
    {kUndoMatrixWizard, "Ran Kesh Matrix Wizard - ", Comment, 0},
    {kUndoChannelWizard, "Ran Channel Wizard - ", Comment, 0},
    {kUndoRenameWizard, "Ran Rename Wizard - ", Comment, 0},
    {kUndoEditorProperties, "Changed Editor Properties", Nothing, kStateSelectFixture},
    {kUndoReferenceUpdate, "Updated Channels from Reference File", Nothing, kStateSelectFixture},
    {kUndoUnnamed, "", Nothing, 0},
}};
static_assert([] {
    for (std::size_t row = 0; row < kRows.size(); ++row) {
        if (kRows[row].code != static_cast<std::int32_t>(row) + 1) return false;
    }
    return true;
}());

constexpr std::array<std::pair<std::int32_t, std::int32_t>, 4> kOnProps{{{kUndoCut, kUndoCutProp},
                                                                         {kUndoPasted, kUndoPastedProp},
                                                                         {kUndoChanged, kUndoChangedProp},
                                                                         {kUndoSentHome, kUndoSentPropHome}}};

std::string_view nameFor(UndoName name, int objectIndex, std::string_view comment, const ZephSimulation& simulation) {
    switch (name) {
    case Fixture:
        return fixtureOrEmpty(simulation, objectIndex).Name;
    case Prop:
        return propOrEmpty(simulation, objectIndex).Name;
    case PropOfFixture:
        return propOrEmpty(simulation, fixtureOrEmpty(simulation, objectIndex).AssignedItem).Name;
    case Comment:
        return comment;
    default:
        return "";
    }
}

}  // namespace

const UndoActionRow& undoActionRow(std::int32_t code) noexcept {
    const bool known = code >= 1 && code <= kUndoUnnamed;
    return kRows[static_cast<std::size_t>(known ? code : kUndoUnnamed) - 1];
}

std::int32_t undoActionOnProps(std::int32_t code) noexcept {
    for (const auto& [onFixture, onProp] : kOnProps) {
        if (code == onFixture) return onProp;
    }
    return code;
}

std::string undoText(std::int32_t code, int objectIndex, std::string_view comment, const ZephSimulation& simulation) {
    const UndoActionRow& row = undoActionRow(code);
    const std::string_view name = nameFor(row.name, objectIndex, comment, simulation);
    if (code == kUndoEndDrawing && name.empty()) return "End New Drawing";
    return std::string(row.text).append(name);
}
