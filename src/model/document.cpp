#include "model/document.h"

#include "util/units.h"

#include <algorithm>

namespace {

std::int32_t fixtureBound(const ZephSimulation& simulation) {
    return std::clamp(simulation.FixtureCount, 0, kMaxFixtures);
}
std::int32_t memberBound(const ZephProp& prop) {
    return std::clamp(prop.AssignedCount, 0, kMaxFixturesInProp);
}

}  // namespace

std::int32_t widthPixels(const ZephBackground& background) noexcept {
    return std::max(background.EditorWidthTwips / TwipsPerPixelX, 1);
}

std::int32_t heightPixels(const ZephBackground& background) noexcept {
    return std::max(background.EditorHeightTwips / TwipsPerPixelY, 1);
}

void ZephGlobalReset(bool keepEditState, ZephSimulation& simulation, DocumentWatcher& watcher) {
    if (!keepEditState) watcher.selectionCleared();
    for (int f = 1; f <= kMaxFixtures; ++f) {
        // A damaged file can leave records beyond the count, so each slot is looked at; most are empty.
        static const ZephFixture empty;
        if (!(simulation.Fixtures[f] == empty)) simulation.Fixtures[f] = empty;
    }
    simulation.FixtureCount = 0;
    simulation.Props.fill(ZephProp{});
    simulation.PropCount = 0;
    watcher.editSessionReset();
    simulation.Background.PicFileName.clear();
    simulation.Background.PicIntensity = 100;
    simulation.Background.BackgroundType = 0;
    for (int level = 1; level <= kLevels; ++level) {
        simulation.Levels[level] = {true, true, "Level " + std::to_string(level)};
    }
    simulation.Dimmed = 0;
    if (keepEditState) return;
    simulation.SimulationDirty = false;
    simulation.SimulationOpen = false;
    watcher.clipboardAndStatusCleared();
}

void InitializeFixture(const ZephSettings& settings, ZephFixture& fixture) {
    fixture = ZephFixture{};
    fixture.BulbSpacing = settings.BulbSpacing;
    fixture.BulbSize = settings.BulbSize;
    fixture.BulbShape = settings.BulbShape;
    fixture.ZOrder = std::max(settings.ZOrder, 1);  // the setting may say 0, which is no level
    fixture.Max_Opacity = settings.FloodOpacity;
    fixture.Channel_Type = kChannelNormal;
    fixture.Fixture_Type = kFixtureStrings;
}

bool ZephAddFixtureToProp(int fixture, int prop, ZephSimulation& simulation) {
    ZephProp& target = simulation.Props.at(prop);
    const std::int32_t count = memberBound(target);
    const auto end = target.Object.begin() + count;
    if (std::find(target.Object.begin(), end, fixture) != end) return true;
    const bool added = count < kMaxFixturesInProp;
    if (added) {
        target.AssignedCount = count + 1;
        target.Object[target.AssignedCount] = fixture;
    }
    // Even when the prop is full the fixture points at it: displays exist that rely on the name it then shows.
    ZephFixture& record = simulation.Fixtures.at(fixture);
    record.AssignedItem = prop;
    record.AssignedItemName = target.Name;
    simulation.SimulationDirty = true;
    return added;
}

bool ZephDeleteFixtureFromProp(int fixture, int prop, ZephSimulation& simulation) {
    simulation.SimulationDirty = true;  // before the search: a miss marks the document too
    if (!simulation.Props.contains(prop)) return false;
    ZephProp& owner = simulation.Props[prop];
    const auto end = owner.Object.begin() + memberBound(owner);
    const auto found = std::find(owner.Object.begin(), end, fixture);
    if (found == end) return false;
    std::move(found + 1, owner.Object.end(), found);
    owner.Object[kMaxFixturesInProp] = 0;
    --owner.AssignedCount;
    return true;
}

bool ZephDisassociateFromProp(int fixture, int prop, ZephSimulation& simulation) {
    const bool listed = ZephDeleteFixtureFromProp(fixture, prop, simulation);
    ZephFixture& record = simulation.Fixtures.at(fixture);
    record.AssignedItem = 0;
    record.AssignedItemName.clear();
    return listed;
}

bool ZephDeleteThisProp(int prop, ZephSimulation& simulation) {
    const ZephProp& doomed = simulation.Props.at(prop);
    for (int slot = 1; slot <= memberBound(doomed); ++slot) {
        if (!simulation.Fixtures.contains(doomed.Object[slot])) continue;
        ZephFixture& member = simulation.Fixtures[doomed.Object[slot]];
        member.AssignedItem = 0;
        member.AssignedItemName.clear();
    }
    std::move(simulation.Props.begin() + prop, simulation.Props.end(), simulation.Props.begin() + prop - 1);
    simulation.Props[kMaxProps] = ZephProp{};
    ZephRetreatFixturePointers(prop, simulation);
    --simulation.PropCount;
    simulation.SimulationDirty = true;
    return true;
}

void ZephRetreatFixturePointers(int deletedProp, ZephSimulation& simulation) {
    for (int f = 1; f <= fixtureBound(simulation); ++f) {
        std::int32_t& owner = simulation.Fixtures[f].AssignedItem;
        if (owner > deletedProp) --owner;
    }
}

void ZephRetreatPropPointers(int deletedFixture, ZephSimulation& simulation) {
    for (ZephProp& prop : simulation.Props) {
        for (std::int32_t& member : prop.Object) {
            if (member > deletedFixture) --member;
        }
    }
}

void ZephDeleteThisFixture(int fixture, bool suppressListRebuild, ZephSimulation& simulation,
                           DocumentWatcher& watcher) {
    const std::int32_t owner = simulation.Fixtures.at(fixture).AssignedItem;
    if (owner != 0) ZephDeleteFixtureFromProp(fixture, owner, simulation);
    const std::int32_t count = fixtureBound(simulation);
    std::move(simulation.Fixtures.begin() + fixture, simulation.Fixtures.begin() + count,
              simulation.Fixtures.begin() + fixture - 1);
    simulation.Fixtures[count] = ZephFixture{};
    ZephRetreatPropPointers(fixture, simulation);
    watcher.fixtureRemoved(fixture);
    watcher.selectionCleared();
    simulation.FixtureCount = count - 1;
    if (!suppressListRebuild) watcher.objectListChanged();
    simulation.SimulationDirty = true;
    watcher.canvasChanged();
}

bool ZephDeleteFixturesByProp(int fixture, ZephSimulation& simulation, DocumentWatcher& watcher) {
    const std::int32_t prop = simulation.Fixtures.at(fixture).AssignedItem;
    if (!simulation.Props.contains(prop)) {
        ZephDeleteThisFixture(fixture, false, simulation, watcher);
        return true;
    }
    ZephProp& owner = simulation.Props[prop];
    while (owner.AssignedCount > 0) {
        const std::int32_t member = owner.Object[1];
        // A member that does not know this prop would never leave its list.
        const bool known = simulation.Fixtures.contains(member) && member <= fixtureBound(simulation) &&
                           simulation.Fixtures[member].AssignedItem == prop;
        if (known) {
            ZephDeleteThisFixture(member, true, simulation, watcher);
        } else {
            ZephDeleteFixtureFromProp(member, prop, simulation);
        }
    }
    watcher.objectListChanged();
    return true;
}

void nameAssignedProps(ZephSimulation& simulation) {
    for (int f = 1; f <= fixtureBound(simulation); ++f) {
        ZephFixture& fixture = simulation.Fixtures[f];
        if (fixture.AssignedItem != 0) fixture.AssignedItemName = propOrEmpty(simulation, fixture.AssignedItem).Name;
    }
}

std::string ZephReturnNewFixtureName(const ZephSimulation& simulation) {
    for (int n = 1;; ++n) {
        std::string name = "New Fixture " + std::to_string(n);
        const auto end = simulation.Fixtures.begin() + fixtureBound(simulation);
        if (std::none_of(simulation.Fixtures.begin(), end, [&](const ZephFixture& f) { return f.Name == name; })) {
            return name;
        }
    }
}

const ZephFixture& fixtureOrEmpty(const ZephSimulation& simulation, int fixture) {
    static const ZephFixture empty;
    return simulation.Fixtures.contains(fixture) ? simulation.Fixtures[fixture] : empty;
}

const ZephProp& propOrEmpty(const ZephSimulation& simulation, int prop) {
    static const ZephProp empty;
    return simulation.Props.contains(prop) ? simulation.Props[prop] : empty;
}
