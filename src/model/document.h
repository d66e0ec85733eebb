// The primitives that change the document and keep its records consistent. Fixtures and props are named by their slot,
// from 1; slots move when a record before them goes. The primitives do not fail, apart from the false results stated.
#pragma once

#include "model/settings.h"
#include "model/simulation.h"

// Told of what the primitives do beyond the records: whoever keeps something beside the document follows it here.
class DocumentWatcher {
public:
    virtual ~DocumentWatcher() = default;
    virtual void selectionCleared() = 0;
    virtual void fixtureRemoved(int fixture) = 0;  // the fixtures after it moved down by one
    virtual void objectListChanged() = 0;
    virtual void canvasChanged() = 0;
    virtual void editSessionReset() = 0;  // the fixture in progress, the remembered background; see ZephGlobalReset
    virtual void clipboardAndStatusCleared() = 0;
};

// For a document that nothing is kept beside.
class NoWatcher : public DocumentWatcher {
public:
    void selectionCleared() override {}
    void fixtureRemoved(int) override {}
    void objectListChanged() override {}
    void canvasChanged() override {}
    void editSessionReset() override {}
    void clipboardAndStatusCleared() override {}
};

// Empties the document. keepEditState: the selection, the clipboard and the state flags stay.
void ZephGlobalReset(bool keepEditState, ZephSimulation& simulation, DocumentWatcher& watcher);

// The defaults of a fixture record before it is filled from a file; everything else is cleared.
void InitializeFixture(const ZephSettings& settings, ZephFixture& fixture);

// False when the prop is full: the fixture then still names the prop, which does not list it.
bool ZephAddFixtureToProp(int fixture, int prop, ZephSimulation& simulation);
// False when the prop does not list the fixture; the document is marked dirty all the same.
bool ZephDeleteFixtureFromProp(int fixture, int prop, ZephSimulation& simulation);
// As above, and the fixture forgets the prop in both outcomes.
bool ZephDisassociateFromProp(int fixture, int prop, ZephSimulation& simulation);
bool ZephDeleteThisProp(int prop, ZephSimulation& simulation);

void ZephDeleteThisFixture(int fixture, bool suppressListRebuild, ZephSimulation& simulation, DocumentWatcher& watcher);
// A lone fixture is deleted; of a prop's fixture the whole prop is emptied, and the prop stays.
bool ZephDeleteFixturesByProp(int fixture, ZephSimulation& simulation, DocumentWatcher& watcher);

// Lowers by one every reference above the deleted slot.
void ZephRetreatFixturePointers(int deletedProp, ZephSimulation& simulation);
void ZephRetreatPropPointers(int deletedFixture, ZephSimulation& simulation);

// Gives every fixture that names a prop the prop's name: what a file does not hold and every load fills in.
void nameAssignedProps(ZephSimulation& simulation);

// The first of "New Fixture 1", "New Fixture 2", ... that no fixture has.
std::string ZephReturnNewFixtureName(const ZephSimulation& simulation);

// The records that a number found in a file may point at. Out of range, it reads as an empty record.
const ZephFixture& fixtureOrEmpty(const ZephSimulation& simulation, int fixture);
const ZephProp& propOrEmpty(const ZephSimulation& simulation, int prop);
