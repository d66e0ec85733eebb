// Writes the elements that editor, fixture and prop files share, each with its attributes in the files' order. A
// procedure that creates a group leaves it open for the children that the caller adds; closing it is the caller's.
#pragma once

#include "model/simulation.h"
#include "model/xml_text.h"
#include "util/paths.h"

// Blanks before an element and before the end tag of its group.
inline constexpr int kIndentGroup = 4;    // Background, Levels, Items, DrawObjects
inline constexpr int kIndentRecord = 8;   // Level, Item, DrawObject
inline constexpr int kIndentPart = 12;    // Sample ... DrawPoints, AssignedObject
inline constexpr int kIndentMember = 16;  // Channel, DrawPoint

inline constexpr std::string_view kFileVersion = "3.0.0";

// The XML declaration and the line break behind it.
void CreateProcessingInstructions(XmlText& text);
// The root's start tag, still open for more attributes. createdAt: see createdAtNow.
void CreateTopNode(std::string_view rootName, std::string_view version, std::string_view createdAt, XmlText& text);

void CreateBackgroundNode(const ZephBackground& background, const ZephPathService& paths, XmlText& text);
void CreateLevelsGroupAndNode(const ZephSimulation& simulation, XmlText& text);

// A group of records, empty when there are none; every group that was created is ended by CloseGroup.
void CreateMasterPropsGroup(bool hasProps, XmlText& text);
void CreatePropGroupAndNodes(int id, const ZephProp& prop, XmlText& text);
void CreateMasterDrawObjectsGroup(bool hasFixtures, XmlText& text);
void CloseMasterPropsGroup(bool hasProps, XmlText& text);
void CloseMasterDrawObjectsGroup(bool hasFixtures, XmlText& text);

// A fixture: its start tag, its parts, its end tag.
void CreateDrawObjectGroup(int id, const ZephFixture& fixture, XmlText& text);
void CreateSampleColorsNode(const ZephFixture& fixture, XmlText& text);
void CreateQvFixtureNode(const ZephFixture& fixture, XmlText& text);
void CreateKeshNode(const ZephFixture& fixture, XmlText& text);
void CreateDMXPixelNode(const ZephFixture& fixture, XmlText& text);
void CreateDrawObjectChannelGroup(const ZephFixture& fixture, XmlText& text);  // with a CreateChannelNode each
void CreateChannelNode(int id, const ZephChannel& channel, XmlText& text);
void CreateDrawPointsGroupAndNode(const ZephFixture& fixture, XmlText& text);
void CloseDrawObjectGroup(XmlText& text);

// The part that only this type of fixture has: Kesh, DMX, or, unless left out, AssignedChannels.
void CreateHardwareNode(const ZephFixture& fixture, bool withChannels, XmlText& text);

// The present date, a blank and the present time in the user's short formats, with the seconds always there.
std::string createdAtNow();
