// What can be undone: a code for every kind of change, and how its undo step is described.
#pragma once

#include "model/simulation.h"

#include <array>
#include <string>
#include <string_view>

inline constexpr std::int32_t kUndoDeletedFixture = 1;
inline constexpr std::int32_t kUndoInsertedFixture = 2;
inline constexpr std::int32_t kUndoInsertedSymbol = 3;
inline constexpr std::int32_t kUndoEndDrawing = 4;
inline constexpr std::int32_t kUndoAddedPoints = 5;
inline constexpr std::int32_t kUndoCut = 6;
inline constexpr std::int32_t kUndoPasted = 7;
inline constexpr std::int32_t kUndoFixtureProperties = 8;
inline constexpr std::int32_t kUndoChanged = 9;
inline constexpr std::int32_t kUndoSentHome = 10;
inline constexpr std::int32_t kUndoSentToForeground = 11;
inline constexpr std::int32_t kUndoSentToBackground = 12;
inline constexpr std::int32_t kUndoMovedForward = 13;
inline constexpr std::int32_t kUndoMovedBackward = 14;
inline constexpr std::int32_t kUndoLockedFixture = 15;
inline constexpr std::int32_t kUndoUnlockedFixture = 16;
inline constexpr std::int32_t kUndoCreatedProp = 17;
inline constexpr std::int32_t kUndoDeletedProp = 18;
inline constexpr std::int32_t kUndoPropProperties = 19;
inline constexpr std::int32_t kUndoDeletedPropOfFixture = 20;
inline constexpr std::int32_t kUndoCutProp = 21;
inline constexpr std::int32_t kUndoInsertedProp = 22;
inline constexpr std::int32_t kUndoPastedProp = 23;
inline constexpr std::int32_t kUndoChangedProp = 24;
inline constexpr std::int32_t kUndoSentPropHome = 25;
inline constexpr std::int32_t kUndoLockedProp = 26;
inline constexpr std::int32_t kUndoUnlockedProp = 27;
inline constexpr std::int32_t kUndoKeshWizard = 28;
inline constexpr std::int32_t kUndoTreeWizard = 29;
inline constexpr std::int32_t kUndoArchWizard = 30;
inline constexpr std::int32_t kUndoMatrixWizard = 31;
inline constexpr std::int32_t kUndoChannelWizard = 32;
inline constexpr std::int32_t kUndoRenameWizard = 33;
inline constexpr std::int32_t kUndoEditorProperties = 34;
inline constexpr std::int32_t kUndoReferenceUpdate = 35;
inline constexpr std::int32_t kUndoUnnamed = 36;

// Whose name follows the text.
enum class UndoName { Nothing, Fixture, Prop, PropOfFixture, Comment };

struct UndoActionRow {
    std::int32_t code;
    std::string_view text;
    UndoName name;
    int forcedMode;  // the ZephUIState to return to; 0 = the one in which the change was made
};

// By code, 1..36. A code outside reads as one without a text.
const UndoActionRow& undoActionRow(std::int32_t code) noexcept;

// What the codes for a fixture become while props are selected; every other code stays.
std::int32_t undoActionOnProps(std::int32_t code) noexcept;

// The description of a step. objectIndex: the fixture or prop that the change is on, as the action's row says.
std::string undoText(std::int32_t code, int objectIndex, std::string_view comment, const ZephSimulation& simulation);
