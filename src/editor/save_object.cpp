#include "editor/save_object.h"

#include <algorithm>

namespace {

constexpr std::string_view kSaveFixtureQuestion =
    " can save fixtures with or without the associated channel data. \r\nSaving the channel data along with the "
    "fixture allows you to more easily use this fixture in other simulations that you create with the program.  "
    "However, if you are saving this fixture to share with others, you should remove the channel data since it will "
    "not match with others' configurations.\r\n\r\nShould channel data be saved with this fixture?";
constexpr std::string_view kSavePropQuestion =
    " can save props with or without the associated channel data. \r\nSaving fixture channel data along with the prop "
    "allows you to more easily use this prop in other simulations that you create with the program.  However, if you "
    "are saving this prop to share with others, you should remove the channel data since it will not match with "
    "other's configurations.\r\n\r\nShould channel data be saved with this prop's fixtures?";

int askChannelChoice(bool hasChannels, std::string_view question, Host& host) {
    if (!hasChannels) return kChannelChoiceNo;
    const BoxAnswer answer =
        host.messageBox(boxTitle("-Save channel data"), boxTitle(question), BoxIcon::Question, BoxButtons::YesNo);
    return answer == BoxAnswer::Yes ? kChannelChoiceYes : kChannelChoiceNo;
}

bool anyChannels(const ZephSimulation& simulation, const ZephProp& prop) {
    const int members = std::clamp(prop.AssignedCount, 0, kMaxFixturesInProp);
    return std::any_of(prop.Object.begin(), prop.Object.begin() + members,
                       [&](std::int32_t member) { return fixtureOrEmpty(simulation, member).ChannelCount > 0; });
}

}  // namespace

void cmdSaveAsFixture_Click(const ZephFixture& fixture, const ObjectSaveContext& context) try {
    std::string path;
    if (!context.dialogs.chooseOutput(kSaveFixtureFile, path)) return;
    context.settings.LastFixtureFile = path;
    const int choice = askChannelChoice(fixture.ChannelCount > 0, kSaveFixtureQuestion, context.saving.host);
    ZephSaveFixtureXML(fixture, path, choice, context.saving);
}
ZEPH_GUARD(context.saving.failures, "frmZephFixtureProperties", )

void cmdSaveAsProp_Click(const ZephSimulation& simulation, const ZephProp& prop, const ObjectSaveContext& context) try {
    std::string path;
    if (!context.dialogs.chooseOutput(kSavePropFile, path)) return;
    context.settings.LastPropFile = path;
    const int choice = askChannelChoice(anyChannels(simulation, prop), kSavePropQuestion, context.saving.host);
    ZephSavePropXML(simulation, prop, path, choice, context.saving);
}
ZEPH_GUARD(context.saving.failures, "frmZephPropProperties", )
