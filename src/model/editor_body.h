// The body of an editor file: everything inside the root element. A damaged body gives a partial document, not an
// empty one: each record fails for itself and the walk goes on.
#pragma once

#include "model/editor_records.h"

namespace editor_body_detail {

struct BodyRules {
    const char* procedure;  // under which an ID that is none is reported
    bool version3;          // ribbon export data, DMX pixels and the full record of a prop; not yet in version 2
};

// What a body is read with; the same for all its elements.
struct BodyContext {
    const BodyRules& rules;
    const ZephSettings& settings;
    const ZephPathService& paths;
    FailureReport& failures;
};

// The number of an Item or a DrawObject, or 0 when there is none to be had.
template <typename Node>
int takeSlot(const Node& node, int max, const BodyContext& context) try {
    return slotAttribute(node, max);
} catch (...) {
    reportCaughtFailure(context.failures, kLoadModule, context.rules.procedure, __LINE__);
    return 0;
}

template <typename Node>
bool loadProp(const Node& item, const BodyContext& context, ZephProp& prop) {
    return context.rules.version3 ? LoadProp300(item, context.failures, prop)
                                  : LoadProp200(item, context.failures, prop);
}

template <typename Node>
bool loadItems(const Node& items, const BodyContext& context, ZephSimulation& simulation) {
    bool result = true;
    for (Node item = items.firstElement(); item; item = item.nextElement()) {
        if (item.name() != "Item") continue;
        const int slot = takeSlot(item, kMaxProps, context);
        if (slot == 0) {
            result = false;
            continue;
        }
        simulation.PropCount = slot;
        const bool read = loadProp(item, context, simulation.Props[slot]);
        result = result && read;
    }
    return result;
}

template <typename Node>
bool loadFixturePart(const Node& part, const BodyContext& context, bool ledDefault, ZephFixture& fixture,
                     bool& channelsSeen) {
    const std::string_view name = part.name();
    if (name == "DrawPoints") return LoadPoints(part, context.failures, fixture);
    if (name == "AssignedChannels") return LoadChannels(part, ledDefault, context.failures, fixture, channelsSeen);
    if (name == "Sample") return LoadSampleColors(part, context.failures, fixture);
    if (name == "Kesh") return LoadKeshData(part, context.failures, fixture);
    if (!context.rules.version3) return true;
    if (name == "DMX") return LoadDMXData(part, context.failures, fixture);
    if (name == "Novaline_Data") return LoadQvFixtureData(part, context.failures, fixture);
    return true;
}

// A DrawObject with all its parts. ledDefault and channelsSeen: as their readers say.
template <typename Node>
bool loadDrawObject(const Node& object, const BodyContext& context, ZephFixture& fixture, bool& ledDefault,
                    bool& channelsSeen) {
    bool read = context.rules.version3
                    ? LoadFixtureParms(object, context.settings, context.failures, fixture)
                    : LoadFixtureParms200(object, context.settings, context.failures, fixture, ledDefault);
    for (Node part = object.firstElement(); part; part = part.nextElement())
        read = loadFixturePart(part, context, ledDefault, fixture, channelsSeen) && read;
    return read;
}

template <typename Node>
bool loadDrawObjects(const Node& objects, const BodyContext& context, ZephSimulation& simulation) {
    bool result = true;
    for (Node object = objects.firstElement(); object; object = object.nextElement()) {
        if (object.name() != "DrawObject") continue;
        const int slot = takeSlot(object, kMaxFixtures, context);
        if (slot == 0) {
            result = false;
            continue;
        }
        simulation.FixtureCount = slot;
        bool channelsSeen = false;  // asked for only when single objects are loaded
        const bool read =
            loadDrawObject(object, context, simulation.Fixtures[slot], simulation.FixtureLedDefault, channelsSeen);
        result = result && read;
    }
    return result;
}

template <typename Node>
bool loadBody(const Node& root, const BodyContext& context, ZephSimulation& simulation) {
    bool result = true;
    for (Node child = root.firstElement(); child; child = child.nextElement()) {
        const std::string_view name = child.name();
        if (name == "Background") {
            result = LoadBackground(child, context.paths, context.failures, simulation.Background) && result;
        } else if (name == "Levels") {
            result = LoadLevels(child, context.failures, simulation) && result;
        } else if (name == "Items") {
            result = loadItems(child, context, simulation) && result;
        } else if (name == "DrawObjects") {
            result = loadDrawObjects(child, context, simulation) && result;
        } else {
            result = false;
        }
    }
    nameAssignedProps(simulation);
    return result;
}

}  // namespace editor_body_detail

// Versions 1.5.2 to 2.1.0.
template <typename Node>
bool LoadVisualizerBody200(const Node& root, const ZephSettings& settings, const ZephPathService& paths,
                           FailureReport& failures, ZephSimulation& simulation) try {
    constexpr editor_body_detail::BodyRules kRules{"LoadVisualizerBody200", false};
    return editor_body_detail::loadBody(root, {kRules, settings, paths, failures}, simulation);
}
ZEPH_GUARD(failures, kLoadModule, false)

// Version 3.0.0.
template <typename Node>
bool LoadVisualizerBody300(const Node& root, const ZephSettings& settings, const ZephPathService& paths,
                           FailureReport& failures, ZephSimulation& simulation) try {
    constexpr editor_body_detail::BodyRules kRules{"LoadVisualizerBody300", true};
    return editor_body_detail::loadBody(root, {kRules, settings, paths, failures}, simulation);
}
ZEPH_GUARD(failures, kLoadModule, false)
