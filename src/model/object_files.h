// Fixture files (.zff) and prop files (.zpf), which carry single objects from one display to another: the same
// elements as in an editor file, below a root of their own. Called by the property dialogs and the Insert commands.
#pragma once

#include "model/editor_loader.h"

// The answer to whether channels are saved too, as a message box of the platform numbers it.
inline constexpr int kChannelChoiceYes = 6;
inline constexpr int kChannelChoiceNo = 7;

// The files' texts. createdAt: see createdAtNow. A member of the prop that is no fixture is written as an empty one,
// so that every member keeps its place.
std::string fixtureFileText(const ZephFixture& fixture, int channelChoice, std::string_view createdAt);
std::string propFileText(const ZephSimulation& simulation, const ZephProp& prop, int channelChoice,
                         std::string_view createdAt);

// What saving an object uses besides it.
struct ObjectSaving {
    std::string_view createdAt;
    Host& host;
    FailureReport& failures;
};

// Replace the file under the path, whole or not at all. False when that failed, which was told or reported.
bool ZephSaveFixtureXML(const ZephFixture& fixture, const std::string& path, int channelChoice,
                        const ObjectSaving& saving);
bool ZephSavePropXML(const ZephSimulation& simulation, const ZephProp& prop, const std::string& path, int channelChoice,
                     const ObjectSaving& saving);

// Appends the file's fixture to the document; it stands alone there. channelsSeen: whether it came with channels. A
// file that fails leaves nothing behind. Every failure is told in message boxes.
[[nodiscard]] bool ZephLoadFixtureFileXML(const std::string& path, const EditorFileContext& context,
                                          ZephSimulation& simulation, bool& channelsSeen);

// Appends the file's prop and its fixtures. Member n is the file's fixture n, whatever number the file states; a prop
// lists no more fixtures than it came with, and fixtures that it does not list stand alone. Of a prop that fails on
// the way the fixtures read so far stay, alone; one that would pass the limits leaves nothing behind.
[[nodiscard]] bool ZephLoadPropFileXML(const std::string& path, const EditorFileContext& context,
                                       ZephSimulation& simulation, bool& channelsSeen);

// As the files of those texts, already in memory.
[[nodiscard]] bool loadFixtureFileText(std::string_view text, TextReading reading, const EditorFileContext& context,
                                       ZephSimulation& simulation, bool& channelsSeen);
[[nodiscard]] bool loadPropFileText(std::string_view text, TextReading reading, const EditorFileContext& context,
                                    ZephSimulation& simulation, bool& channelsSeen);
