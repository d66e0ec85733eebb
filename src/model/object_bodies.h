// The bodies of fixture and prop files: everything inside their root elements, appended to the document. Unlike the
// body of an editor file, one that fails is taken back.
#pragma once

#include "model/editor_body.h"
#include "model/editor_loader.h"

namespace object_bodies_detail {

using editor_body_detail::BodyContext;
using editor_body_detail::BodyRules;

// The slot that was taken last, given back and cleared.
inline void dropLastFixture(ZephSimulation& simulation) {
    simulation.Fixtures[simulation.FixtureCount] = ZephFixture{};
    --simulation.FixtureCount;
}
inline void dropLastProp(ZephSimulation& simulation) {
    simulation.Props[simulation.PropCount] = ZephProp{};
    --simulation.PropCount;
}

// Tells why, and gives the failure result.
inline bool refuse(Host& host, std::string_view suffix, std::string_view text) {
    host.messageBox(boxTitle(suffix), text, BoxIcon::Critical);
    return false;
}

// Calls visit with every element of the name inside the root's groups of the other name.
template <typename Node, typename Visit>
void forEachRecord(const Node& root, std::string_view group, std::string_view record, Visit visit) {
    for (Node child = root.firstElement(); child; child = child.nextElement()) {
        if (child.name() != group) continue;
        for (Node element = child.firstElement(); element; element = element.nextElement()) {
            if (element.name() == record) visit(element);
        }
    }
}

// Into the slot, where it stands alone: the prop of the display that it comes from does not come along.
template <typename Node>
bool readLoneFixture(const Node& object, const BodyContext& body, int slot, ZephSimulation& simulation,
                     bool& channelsSeen) {
    ZephFixture& fixture = simulation.Fixtures.at(slot);
    const bool read =
        editor_body_detail::loadDrawObject(object, body, fixture, simulation.FixtureLedDefault, channelsSeen);
    fixture.AssignedItem = 0;
    return read;
}

template <typename Node>
bool loadFixtureBody(const Node& root, const BodyRules& rules, const EditorFileContext& context,
                     ZephSimulation& simulation, bool& channelsSeen) {
    if (simulation.FixtureCount >= kMaxFixtures) {
        return refuse(context.host, "-Too many fixtures",
                      "You can not load this fixture since it would exceed the maximum number of fixtures allowed.");
    }
    const BodyContext body{rules, context.settings, context.paths, context.failures};
    const int slot = ++simulation.FixtureCount;
    bool found = false;
    bool result = true;
    forEachRecord(root, "DrawObjects", "DrawObject", [&](const Node& object) {
        found = true;
        result = readLoneFixture(object, body, slot, simulation, channelsSeen) && result;
    });
    if (!found || !result) dropLastFixture(simulation);
    return found && result;
}

// What the walk through a prop file has found.
struct PropWalk {
    int base;  // fixtures of the document before
    bool found = false;
    bool result = true;
    bool tooMany = false;
};

template <typename Node>
void readItems(const Node& items, const BodyContext& body, ZephSimulation& simulation, PropWalk& walk) {
    for (Node item = items.firstElement(); item; item = item.nextElement()) {
        if (item.name() != "Item") continue;
        walk.found = true;
        walk.result = editor_body_detail::loadProp(item, body, simulation.Props[simulation.PropCount]) && walk.result;
    }
}

template <typename Node>
void readObjects(const Node& objects, const BodyContext& body, ZephSimulation& simulation, PropWalk& walk,
                 bool& channelsSeen) {
    walk.tooMany = walk.base + simulation.Props[simulation.PropCount].AssignedCount > kMaxFixtures;
    for (Node object = objects.firstElement(); object && !walk.tooMany; object = object.nextElement()) {
        if (object.name() != "DrawObject") continue;
        // A file may hold more fixtures than its prop lists.
        walk.tooMany = simulation.FixtureCount >= kMaxFixtures;
        if (walk.tooMany) return;
        const int slot = ++simulation.FixtureCount;
        walk.result = readLoneFixture(object, body, slot, simulation, channelsSeen) && walk.result;
    }
}

// The file's numbers are those of another display: member n is the n-th fixture that came along.
inline void adoptMembers(int base, ZephSimulation& simulation) {
    ZephProp& prop = simulation.Props[simulation.PropCount];
    prop.AssignedCount = std::min(prop.AssignedCount, simulation.FixtureCount - base);
    prop.Object.fill(0);
    for (int member = 1; member <= prop.AssignedCount; ++member) {
        prop.Object[member] = base + member;
        ZephFixture& fixture = simulation.Fixtures[base + member];
        fixture.AssignedItem = simulation.PropCount;
        fixture.AssignedItemName = prop.Name;
    }
}

template <typename Node>
bool loadPropBody(const Node& root, const BodyRules& rules, const EditorFileContext& context,
                  ZephSimulation& simulation, bool& channelsSeen) {
    if (simulation.PropCount >= kMaxProps) {
        return refuse(context.host, "-Too many props",
                      "You can not load this prop since it would exceed the maximum number of props allowed.");
    }
    const BodyContext body{rules, context.settings, context.paths, context.failures};
    PropWalk walk{simulation.FixtureCount};
    simulation.Props[++simulation.PropCount] = ZephProp{};
    for (Node child = root.firstElement(); child && !walk.tooMany; child = child.nextElement()) {
        if (child.name() == "Items") readItems(child, body, simulation, walk);
        if (child.name() == "DrawObjects") readObjects(child, body, simulation, walk, channelsSeen);
    }
    if (walk.found && walk.result && !walk.tooMany) {
        adoptMembers(walk.base, simulation);
        return true;
    }
    dropLastProp(simulation);
    if (!walk.tooMany) return false;
    while (simulation.FixtureCount > walk.base)
        dropLastFixture(simulation);
    return refuse(context.host, "-Too many fixtures",
                  "You can not load this prop since it would exceed the maximum number of fixtures allowed.");
}

}  // namespace object_bodies_detail

// Versions 1.5.2 to 2.1.0, and version 3.0.0. channelsSeen: set when there is a channel, else left as it was. False
// where anything failed, which was reported, where a limit stands against it, or where the object is not in the file.
template <typename Node>
bool LoadFixtureBody200(const Node& root, const EditorFileContext& context, ZephSimulation& simulation,
                        bool& channelsSeen) try {
    constexpr object_bodies_detail::BodyRules kRules{"LoadFixtureBody200", false};
    return object_bodies_detail::loadFixtureBody(root, kRules, context, simulation, channelsSeen);
}
ZEPH_GUARD(context.failures, kLoadModule, false)

template <typename Node>
bool LoadFixtureBody300(const Node& root, const EditorFileContext& context, ZephSimulation& simulation,
                        bool& channelsSeen) try {
    constexpr object_bodies_detail::BodyRules kRules{"LoadFixtureBody300", true};
    return object_bodies_detail::loadFixtureBody(root, kRules, context, simulation, channelsSeen);
}
ZEPH_GUARD(context.failures, kLoadModule, false)

template <typename Node>
bool LoadPropBody200(const Node& root, const EditorFileContext& context, ZephSimulation& simulation,
                     bool& channelsSeen) try {
    constexpr object_bodies_detail::BodyRules kRules{"LoadPropBody200", false};
    return object_bodies_detail::loadPropBody(root, kRules, context, simulation, channelsSeen);
}
ZEPH_GUARD(context.failures, kLoadModule, false)

template <typename Node>
bool LoadPropBody300(const Node& root, const EditorFileContext& context, ZephSimulation& simulation,
                     bool& channelsSeen) try {
    constexpr object_bodies_detail::BodyRules kRules{"LoadPropBody300", true};
    return object_bodies_detail::loadPropBody(root, kRules, context, simulation, channelsSeen);
}
ZEPH_GUARD(context.failures, kLoadModule, false)
