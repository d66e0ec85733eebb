#include "engine/validation.h"

#include "model/tables.h"

#include <algorithm>

namespace {

// One piece of a ribbon or universe.
struct Piece {
    std::int64_t group = 0;  // network and unit of a ribbon, universe of pixels; 0 = not assigned
    bool assigned = false;
    std::int32_t start = 0;  // physical pixel of its first point
    std::int32_t count = 0;  // points
    std::int32_t fixture = 0;
};

// What differs between ribbons and pixel universes.
struct Kind {
    std::int32_t fixtureType;
    std::int32_t limit;  // pixels of an assembled run
    Piece (*piece)(const ZephFixture& fixture);
    std::string (*place)(const ZephFixture& fixture);  // where the run is, as the texts name it
    const char* unassignedBegin;
    const char* unassignedEnd;
    const char* emptyBegin;
    const char* emptyEnd;
    const char* tooLongBegin;
    const char* duplicateBegin;
    const char* orphanBegin;
    const char* orphanEnd;
};

Piece ribbonPiece(const ZephFixture& fixture) {
    Piece piece;
    piece.group = fixture.Kesh.Base_Unit + std::int64_t{fixture.Kesh.Network} * 1000;
    // Network 0 with unit 1 is a place; unit 0 never is.
    piece.assigned = piece.group != 0 && fixture.Kesh.Base_Unit >= 1;
    piece.start = fixture.Kesh.Physical_Pixel_Number;
    return piece;
}

Piece pixelPiece(const ZephFixture& fixture) {
    Piece piece;
    piece.group = fixture.DMX.Universe;
    piece.assigned = piece.group != 0;
    piece.start = fixture.DMX.Physical_Pixel_Number;
    return piece;
}

std::string ribbonPlace(const ZephFixture& fixture) {
    return networkName(fixture.Kesh.Network) + "/" + std::to_string(fixture.Kesh.Base_Unit);
}

std::string pixelPlace(const ZephFixture& fixture) {
    return universeName(fixture.DMX.Universe);
}

// The wording is the one that users' notes and forum answers quote, slips included: "Tarn" for a ribbon, and a missing
// blank after a comma; "Network/Unit ID" in one text and "Network/Unit" in the other.
constexpr Kind kRibbons{kFixtureKesh,
                        kMaxRibbonPixels,
                        ribbonPiece,
                        ribbonPlace,
                        "Tarn Fixture ",
                        " does not have a network and/or unit id assigned.",
                        "Main Tarn Fixture ",
                        " has no pixels (which should be impossible).  Check all pixel fixtures on Network/Unit ID.",
                        "The Tarn on Network/Unit ID ",
                        "The Tarn on Network/Unit ",
                        "Child Tarn fixture ",
                        " does not have a main Tarn Fixture (a Tarn Fixture with physical pixel 1).  A Tarn Fixture "
                        "when assembled requires a fixture with pixel #1"};

constexpr Kind kPixels{
    kFixtureDmxPixels,
    kMaxDmxPixels,
    pixelPiece,
    pixelPlace,
    "DMX Pixel Fixture ",
    " does not have a universe assigned.",
    "Main DMX Pixel Fixture ",
    " has no pixels (which should be impossible).  Check all pixel fixtures on universe.",
    "The DMX Pixel Universe on Universe ",
    "The DMX Pixel Universe on Universe ",
    "Child Pixel fixture ",
    " does not have a main Pixel Fixture (a Pixel Universe Fixture with physical pixel 1).  A Pixel Universe Fixture "
    "when assembled requires a fixture with pixel #1"};

std::vector<Piece> sortedPieces(const Kind& kind, const ZephSimulation& simulation) {
    std::vector<Piece> pieces;
    for (int f = 1; f <= simulation.FixtureCount; ++f) {
        const ZephFixture& fixture = simulation.Fixtures[f];
        if (fixture.Fixture_Type != kind.fixtureType) continue;
        Piece piece = kind.piece(fixture);
        piece.count = fixture.PointCount;
        piece.fixture = f;
        pieces.push_back(piece);
    }
    std::ranges::stable_sort(pieces, [](const Piece& left, const Piece& right) {
        return left.group != right.group ? left.group < right.group : left.start < right.start;
    });
    return pieces;
}

// Walks the sorted pieces and gathers the text of every fault.
class Checker {
public:
    Checker(const Kind& kind, const ZephSimulation& simulation, const std::vector<Piece>& pieces)
        : kind_(kind), simulation_(simulation), pieces_(pieces) {}

    std::string faults() {
        for (std::size_t i = 0; i < pieces_.size(); ++i) {
            const Piece& piece = pieces_[i];
            if (!piece.assigned) {
                add(kind_.unassignedBegin + name(piece) + kind_.unassignedEnd);
            } else if (!open_ || piece.group != pieces_[first_].group) {
                if (open_) closeGroup();
                openGroup(i);
            } else if (reach_ + 1 <= piece.start) {
                reach_ = piece.start + piece.count - 1;
            } else {
                add(kind_.duplicateBegin + place(piece) +
                    ",when assembled has duplicate pixels.  The following fixtures should be checked:\r\n" +
                    overlapList(i - 1));
            }
        }
        // The last group is not closed, so one that is too long runs, cut at the points of a fixture: displays with a
        // single over-long ribbon are out there and must go on playing.
        return text_;
    }

private:
    void add(const std::string& message) { text_ += "\r\n" + message; }
    const ZephFixture& fixture(const Piece& piece) const { return simulation_.Fixtures[piece.fixture]; }
    const std::string& name(const Piece& piece) const { return fixture(piece).Name; }
    std::string place(const Piece& piece) const { return kind_.place(fixture(piece)); }

    bool sameGroup(std::size_t left, std::size_t right) const {
        return right < pieces_.size() && pieces_[left].group == pieces_[right].group;
    }

    void openGroup(std::size_t i) {
        open_ = true;
        first_ = i;
        reach_ = pieces_[i].count;
        // Once a group: the other pieces are compared with this one, main or not.
        if (pieces_[i].start != 1) add(kind_.orphanBegin + name(pieces_[i]) + kind_.orphanEnd);
    }

    void closeGroup() {
        const Piece& head = pieces_[first_];
        if (head.start != 1) return;
        if (reach_ < 0) {
            add(kind_.emptyBegin + name(head) + kind_.emptyEnd);
        } else if (reach_ > kind_.limit) {
            add(kind_.tooLongBegin + place(head) + ", when assembled has more than " + std::to_string(kind_.limit) +
                " pixels (" + std::to_string(reach_) + ").  The following fixtures should be checked:\r\n" +
                memberList());
        }
    }

    std::string memberList() const {
        std::string list;
        for (std::size_t i = first_; sameGroup(first_, i); ++i)
            list += "--" + name(pieces_[i]) + "\r\n";
        return list;
    }

    // From the piece before the present one, so that both that overlap are named.
    std::string overlapList(std::size_t from) const {
        std::string list;
        for (std::size_t i = from; sameGroup(from, i); ++i) {
            list += "--" + name(pieces_[i]) + " (Start Pixel=" + std::to_string(pieces_[i].start);
            if (sameGroup(i, i + 1)) {
                // The next piece's own start plus 1, not the end of this one: the text has always counted so, and a
                // user who follows it step by step ends with pieces that do not overlap.
                list += "  Next start pixel should be " + std::to_string(std::int64_t{pieces_[i + 1].start} + 1) +
                        " or higher.";
            }
            list += ")\r\n";
        }
        return list;
    }

    const Kind& kind_;
    const ZephSimulation& simulation_;
    const std::vector<Piece>& pieces_;
    std::string text_;
    bool open_ = false;
    std::size_t first_ = 0;
    std::int64_t reach_ = -1;
};

void appendPoint(const ZephDrawPoint& point, ZephFixture& fixture) {
    // Only a group that was not closed can come this far; a fixture holds no more.
    if (fixture.PointCount >= kMaxPoints) return;
    fixture.DrawPoints[++fixture.PointCount] = point;
}

void assemble(const std::vector<Piece>& pieces, ZephSimulation& simulation, ZephFixtureStates& states) {
    int main = 0;
    for (const Piece& piece : pieces) {
        if (piece.start == 1) {
            main = piece.fixture;
            states[main].SavedPointCount = simulation.Fixtures[main].PointCount;
            states[main].Assembled = true;
            continue;
        }
        if (main == 0) continue;
        ZephFixture& target = simulation.Fixtures[main];
        while (target.PointCount < piece.start - 1 && target.PointCount < kMaxPoints) {
            appendPoint({kPointPlaceHolder, 0, 0}, target);
        }
        const ZephFixture& child = simulation.Fixtures[piece.fixture];
        for (int p = 1; p <= child.PointCount; ++p)
            appendPoint(child.DrawPoints[p], target);
    }
}

bool validate(const Kind& kind, RenderBuildContext& context) {
    const std::vector<Piece> pieces = sortedPieces(kind, context.simulation);
    const std::string faults = Checker(kind, context.simulation, pieces).faults();
    if (!faults.empty()) {
        context.host.showCompileErrors("There are one or more errors with your simulation that prevent it from running."
                                       "  Please correct these errors and try again." +
                                       faults);
        return false;
    }
    assemble(pieces, context.simulation, context.states);
    return true;
}

}  // namespace

bool ValidateKeshs(RenderBuildContext& context) {
    return validate(kRibbons, context);
}

bool ValidatePixels(RenderBuildContext& context) {
    return validate(kPixels, context);
}
