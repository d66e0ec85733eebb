#include "model/document_snapshot.h"

#include "model/document.h"
#include "model/editor_records.h"
#include "model/xml_text.h"

#include <cstring>
#include <type_traits>

namespace {

static_assert(std::is_trivially_copyable_v<ZephDrawPoint> && sizeof(ZephDrawPoint) == 3 * sizeof(std::int32_t),
              "points are copied as they lie in memory, and compared so");

// Appends fields to a buffer that is used again for every record. Numbers are written without a look at the room:
// each text, each run of points and each record makes enough for the numbers behind it.
class Packer {
public:
    static constexpr bool kPacks = true;

    void begin() {
        used_ = 0;
        makeRoom(0);
    }
    void number(std::int32_t value) noexcept {
        std::memcpy(buffer_.data() + used_, &value, sizeof value);
        used_ += sizeof value;
    }
    void flag(bool value) noexcept { buffer_[used_++] = value ? 1 : 0; }
    void text(const std::string& value) {
        if (holdsForbidden(value)) [[unlikely]]
            return allowed(withoutForbidden(value));
        allowed(value);
    }
    void points(std::int32_t count, const OneBased<ZephDrawPoint, kMaxPoints>& points) {
        const std::size_t bytes = static_cast<std::size_t>(count) * sizeof(ZephDrawPoint);
        makeRoom(bytes);
        std::memcpy(buffer_.data() + used_, points.begin(), bytes);
        used_ += bytes;
    }
    std::string_view packed() const noexcept { return {buffer_.data(), used_}; }

private:
    static constexpr std::size_t kRoomForNumbers = 512;

    void makeRoom(std::size_t bytes) {
        const std::size_t needed = used_ + bytes + kRoomForNumbers;
        if (buffer_.size() < needed) buffer_.resize(2 * needed);
    }
    void allowed(std::string_view value) {
        makeRoom(value.size() + sizeof(std::int32_t));
        number(static_cast<std::int32_t>(value.size()));
        std::memcpy(buffer_.data() + used_, value.data(), value.size());
        used_ += value.size();
    }

    std::vector<char> buffer_;
    std::size_t used_ = 0;
};

// Takes the same fields from a packed record.
class Unpacker {
public:
    static constexpr bool kPacks = false;

    explicit Unpacker(const std::string& packed) : at_(packed.data()) {}

    void number(std::int32_t& value) noexcept {
        std::memcpy(&value, at_, sizeof value);
        at_ += sizeof value;
    }
    void flag(bool& value) noexcept { value = *at_++ != 0; }
    void text(std::string& value) {
        std::int32_t size = 0;
        number(size);
        value.assign(at_, static_cast<std::size_t>(size));
        at_ += size;
    }
    void points(std::int32_t count, OneBased<ZephDrawPoint, kMaxPoints>& points) noexcept {
        const std::size_t bytes = static_cast<std::size_t>(count) * sizeof(ZephDrawPoint);
        std::memcpy(points.begin(), at_, bytes);
        at_ += bytes;
    }

private:
    const char* at_;
};

// The lists of fields, each written once for both directions. The writer writes a count's slots, no more than there
// are; what the reader makes of that is the count that is packed.

template <typename Form, typename Count>
std::int32_t countField(Form& form, Count& count, int max) {
    if constexpr (Form::kPacks) {
        const std::int32_t written = std::clamp(count, 0, max);
        form.number(written);
        return written;
    } else {
        form.number(count);
        return count;
    }
}

template <typename Form, typename Channel>
void channelFields(Form& form, Channel& channel) {
    if constexpr (Form::kPacks) {
        form.number(channel.DeviceType == kDeviceClearedInFile ? kDeviceCleared : channel.DeviceType);
    } else {
        form.number(channel.DeviceType);
    }
    form.number(channel.Network);
    form.number(channel.Controller);
    form.number(channel.Channel);
    form.number(channel.Color);
    form.number(channel.Sub_Type);
    form.number(channel.Sub_Parm);
    for (auto& color : channel.Multi)
        form.number(color);
    form.flag(channel.LED);
    form.text(channel.Name);
}

template <typename Form, typename Fixture>
void hardwareFields(Form& form, Fixture& fixture) {
    if (fixture.Fixture_Type == kFixtureKesh) {
        form.number(fixture.Kesh.Physical_Pixel_Number);
        form.number(fixture.Kesh.Network);
        form.number(fixture.Kesh.Base_Unit);
        form.number(fixture.Kesh.Unit_Mode);
        form.number(fixture.Kesh.Channel_Mode);
        form.number(fixture.Kesh.Resolution);
    } else if (fixture.Fixture_Type == kFixtureDmxPixels) {
        form.number(fixture.DMX.Physical_Pixel_Number);
        form.number(fixture.DMX.Universe);
    } else {
        const std::int32_t channels = countField(form, fixture.ChannelCount, kMaxChannels);
        for (int c = 1; c <= channels; ++c)
            channelFields(form, fixture.Channels[c]);
    }
}

template <typename Form, typename Fixture>
void fixtureFields(Form& form, Fixture& fixture) {
    form.number(fixture.Fixture_Type);
    form.number(fixture.AssignedItem);
    form.number(fixture.BulbSpacing);
    form.number(fixture.BulbSize);
    form.number(fixture.BulbShape);
    form.number(fixture.Channel_Type);
    form.number(fixture.ZOrder);
    form.number(fixture.Max_Opacity);
    form.flag(fixture.Locked);
    form.number(fixture.Sample.Background_Color);
    form.number(fixture.Sample.RGB_R);
    form.number(fixture.Sample.RGB_G);
    form.number(fixture.Sample.RGB_B);
    form.flag(fixture.Novaline.QvReverseOrder);
    form.flag(fixture.Novaline.QvForceRowColumn);
    form.number(fixture.Novaline.QvRow);
    form.number(fixture.Novaline.QvColumn);
    form.number(fixture.Novaline.QvColorTemp);
    form.text(fixture.Name);
    form.text(fixture.Comment);
    form.text(fixture.Novaline.QvLocations);
    hardwareFields(form, fixture);
    form.points(countField(form, fixture.PointCount, kMaxPoints), fixture.DrawPoints);
}

template <typename Form, typename Prop>
void propFields(Form& form, Prop& prop) {
    form.flag(prop.Locked);
    form.flag(prop.QvReverseOrder);
    form.flag(prop.QvForceRowColumn);
    form.number(prop.QvRow);
    form.number(prop.QvColumn);
    form.flag(prop.QvUseMyOrder);
    form.flag(prop.QvStar);
    form.number(prop.QvMatrixInd);
    form.number(prop.QvPropColorTemp);
    form.number(prop.QvWU);
    form.text(prop.Name);
    form.text(prop.Comment);
    form.text(prop.QvFF);
    const std::int32_t members = countField(form, prop.AssignedCount, kMaxFixturesInProp);
    for (int slot = 1; slot <= members; ++slot)
        form.number(prop.Object[slot]);
}

template <typename Form, typename Simulation, typename Picture>
void headFields(Form& form, Simulation& simulation, Picture& storedPicture) {
    form.number(simulation.Background.BackgroundType);
    form.number(simulation.Background.PicIntensity);
    form.number(simulation.Background.EditorWidthTwips);
    form.number(simulation.Background.EditorHeightTwips);
    form.number(simulation.Dimmed);
    form.text(storedPicture);
    for (auto& level : simulation.Levels) {
        form.flag(level.Edit_Enabled);
        form.flag(level.Sim_Enabled);
        form.text(level.Name);
    }
}

bool holds(const std::vector<PackedRecord>& records, std::ptrdiff_t index0, std::string_view packed) {
    return index0 >= 0 && index0 < std::ssize(records) && *records[static_cast<std::size_t>(index0)] == packed;
}

// Finds each record among those of an earlier snapshot. A record that came or went moved all behind it by one; from
// there on they are looked for that much farther.
class Sharing {
public:
    explicit Sharing(const std::vector<PackedRecord>& earlier) : earlier_(earlier) {}

    PackedRecord recordOf(std::ptrdiff_t index0, std::string_view packed) {
        for (const std::ptrdiff_t shift : {shift_, shift_ - 1, shift_ + 1}) {
            if (!holds(earlier_, index0 + shift, packed)) continue;
            shift_ = shift;
            return earlier_[static_cast<std::size_t>(index0 + shift)];
        }
        return std::make_shared<const std::string>(packed);
    }

private:
    const std::vector<PackedRecord>& earlier_;
    std::ptrdiff_t shift_ = 0;
};

template <typename Records, typename Fields>
std::vector<PackedRecord> packAll(const Records& records, std::int32_t count, const std::vector<PackedRecord>& earlier,
                                  Packer& packer, Fields fields) {
    std::vector<PackedRecord> packed;
    packed.reserve(static_cast<std::size_t>(std::max(count, 0)));
    Sharing sharing(earlier);
    for (int n = 1; n <= count; ++n) {
        packer.begin();
        fields(packer, records[n]);
        packed.push_back(sharing.recordOf(n - 1, packer.packed()));
    }
    return packed;
}

template <typename Records, typename Fields>
std::int32_t unpackAll(const std::vector<PackedRecord>& packed, Records& records, Fields fields) {
    int n = 0;
    for (const PackedRecord& record : packed) {
        Unpacker unpacker(*record);
        fields(unpacker, records[++n]);
    }
    return n;
}

constexpr auto kFixtureFields = [](auto& form, auto& fixture) { fixtureFields(form, fixture); };
constexpr auto kPropFields = [](auto& form, auto& prop) { propFields(form, prop); };

}  // namespace

DocumentSnapshot takeSnapshot(const ZephSimulation& simulation, const ZephPathService& paths,
                              const DocumentSnapshot& earlier) {
    require(simulation.PropCount <= kMaxProps && simulation.FixtureCount <= kMaxFixtures,
            "A count of the document is beyond its table");
    Packer packer;
    packer.begin();
    // Only a picture has a name in the file, and the file has its stored form.
    const ZephBackground& background = simulation.Background;
    const std::string picture = background.BackgroundType == kBackgroundPicture
                                    ? paths.CollapsePath(background.PicFileName, kPictureFolder)
                                    : std::string();
    headFields(packer, simulation, picture);
    DocumentSnapshot snapshot;
    const bool sameHead = earlier.taken() && *earlier.Head == packer.packed();
    snapshot.Head = sameHead ? earlier.Head : std::make_shared<const std::string>(packer.packed());
    snapshot.Props = packAll(simulation.Props, simulation.PropCount, earlier.Props, packer, kPropFields);
    snapshot.Fixtures = packAll(simulation.Fixtures, simulation.FixtureCount, earlier.Fixtures, packer, kFixtureFields);
    return snapshot;
}

void restoreSnapshot(const DocumentSnapshot& snapshot, const ZephPathService& paths, ZephSimulation& simulation) {
    require(snapshot.taken(), "There is no document to restore");
    std::string picture;
    Unpacker head(*snapshot.Head);
    headFields(head, simulation, picture);
    simulation.Background.PicFileName = paths.ExpandPath(picture, kPictureFolder);
    simulation.PropCount = unpackAll(snapshot.Props, simulation.Props, kPropFields);
    simulation.FixtureCount = unpackAll(snapshot.Fixtures, simulation.Fixtures, kFixtureFields);
    nameAssignedProps(simulation);
}
