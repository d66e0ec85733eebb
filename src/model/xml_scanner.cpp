#include "model/xml_scanner.h"

#include "model/xml_text.h"

#include <QByteArrayView>

#include <array>
#include <bit>
#include <cstring>

namespace {

enum : std::uint8_t { kNameStart = 1, kNamePart = 2 };

constexpr std::array<std::uint8_t, 256> kClasses = [] {
    std::array<std::uint8_t, 256> classes{};
    for (unsigned code = 0; code < 256; ++code) {
        const bool letter = (code >= 'A' && code <= 'Z') || (code >= 'a' && code <= 'z') || code == '_';
        const bool digit = code >= '0' && code <= '9';
        classes[code] = static_cast<std::uint8_t>((letter ? kNameStart : 0) | (letter || digit ? kNamePart : 0));
    }
    return classes;
}();

bool isClass(char letter, std::uint8_t wanted) noexcept {
    return (kClasses[static_cast<unsigned char>(letter)] & wanted) != 0;
}

bool isWhite(char letter) noexcept {
    return letter == ' ' || letter == '\n' || letter == '\r' || letter == '\t';
}

std::uint64_t eightBytes(const char* at) noexcept {
    std::uint64_t bytes;
    std::memcpy(&bytes, at, sizeof bytes);
    return bytes;
}

// Whether the text goes on with a name that itself stands in the text, so that both may be read past their ends.
bool sameName(const char* at, std::string_view name) noexcept {
    for (std::size_t done = 0; done < name.size(); done += 8) {
        const std::uint64_t difference = eightBytes(at + done) ^ eightBytes(name.data() + done);
        const std::size_t left = name.size() - done;
        if ((left < 8 ? difference << (64 - 8 * left) : difference) != 0) return false;
    }
    return true;
}

constexpr std::uint64_t kEachByte = 0x0101010101010101;

// The high bit of the first byte below the limit (up to 128), and of no byte before it; what stands behind is noise.
constexpr std::uint64_t bytesBelow(std::uint64_t bytes, std::uint64_t limit) noexcept {
    return (bytes - kEachByte * limit) & ~bytes & (kEachByte * 0x80);
}
constexpr std::uint64_t bytesEqual(std::uint64_t bytes, char letter) noexcept {
    return bytesBelow(bytes ^ (kEachByte * static_cast<unsigned char>(letter)), 1);
}

// The first character that ends a plain piece of a value: a quote, '&', or what no usual value has. Eight at a time;
// the zero bytes behind the text end it. The bits of all bytes seen, a few behind the end among them, go into seen.
const char* endOfValuePart(const char* at, std::uint64_t& seen) noexcept {
    static_assert(std::endian::native == std::endian::little, "the first character is taken for the lowest byte");
    for (;; at += 8) {
        const std::uint64_t bytes = eightBytes(at);
        seen |= bytes;
        const std::uint64_t ends =
            bytesBelow(bytes, ' ') | bytesEqual(bytes, '"') | bytesEqual(bytes, '&') | bytesEqual(bytes, '<');
        if (ends != 0) return at + std::countr_zero(ends) / 8;
    }
}

// Compares with a literal of a length known at compile time: a few wide loads, which the slack behind the text allows.
template <std::size_t N>
bool startsWith(const char* at, const char (&literal)[N]) noexcept {
    return std::memcmp(at, literal, N - 1) == 0;
}

// Up to nine digits with an optional minus: what fits 32 bits whatever the digits are. False for anything else.
bool takePlainLong(const char*& at, std::int32_t& value) noexcept {
    const bool negative = *at == '-';
    if (negative) ++at;
    const char* first = at;
    std::int32_t number = 0;
    unsigned digit = static_cast<unsigned>(*at) - '0';
    while (digit <= 9 && at - first < 9) {
        number = number * 10 + static_cast<std::int32_t>(digit);
        digit = static_cast<unsigned>(*++at) - '0';
    }
    value = negative ? -number : number;
    return at != first && digit > 9;
}

bool skipPlainLong(const char*& at) noexcept {
    if (*at == '-') ++at;
    const char* first = at;
    while (static_cast<unsigned>(*at) - '0' <= 9)
        ++at;
    return at != first;
}

// A point in the one spelling that nearly all have; the procedures take its four numbers. On false, at is anywhere.
template <typename Slot, typename Type, typename X, typename Y>
bool passPlainPoint(const char*& at, Slot slot, Type type, X x, Y y) noexcept {
    const auto part = [&at](const auto& before, auto& takeNumber) {
        if (!startsWith(at, before)) return false;
        at += sizeof before - 1;
        return takeNumber(at);
    };
    if (!part("<DrawPoint ID=\"", slot) || !part("\" Type=\"", type) || !part("\" X=\"", x) || !part("\" Y=\"", y) ||
        !startsWith(at, "\"/>")) {
        return false;
    }
    at += 3;
    return true;
}

// Whether a document may hold the value, which is not all ASCII. Kept out of the loop as well.
[[gnu::noinline]] bool isDocumentText(std::string_view value) noexcept {
    return QByteArrayView(value.data(), static_cast<qsizetype>(value.size())).isValidUtf8() && !holdsForbidden(value);
}

struct Entity {
    std::string_view spelling;
    char meaning;
};
// The program writes no others; a name with another one is left to the general parser.
constexpr std::array kEntities{Entity{"&amp;", '&'},  Entity{"&lt;", '<'},    Entity{"&gt;", '>'},
                               Entity{"&quot;", '"'}, Entity{"&apos;", '\''}, Entity{"&#13;", '\r'},
                               Entity{"&#10;", '\n'}, Entity{"&#9;", '\t'}};

// The entity at the beginning of the text, or nullptr. Kept out of the loops that call it: hardly a value has one.
[[gnu::noinline]] const Entity* findEntity(std::string_view text) noexcept {
    const auto* found = std::find_if(kEntities.data(), kEntities.data() + kEntities.size(),
                                     [&](const Entity& known) { return text.starts_with(known.spelling); });
    return found == kEntities.data() + kEntities.size() ? nullptr : found;
}

}  // namespace

std::string_view ScannedNode::name() const {
    return scanner_->frame(depth_).name;
}

ScannedNode ScannedNode::firstElement() const {
    const bool childFollows = scanner_->open_ == depth_ && scanner_->step() == XmlScanner::Tag::Start;
    return {*scanner_, childFollows ? depth_ + 1 : 0};
}

ScannedNode ScannedNode::nextElement() const {
    scanner_->passOver(depth_);
    return {*scanner_, scanner_->step() == XmlScanner::Tag::Start ? depth_ : 0};
}

std::optional<std::string_view> ScannedNode::attribute(std::string_view attributeName) const {
    const XmlScanner::Attribute* found = scanner_->find(depth_, attributeName);
    if (!found) return std::nullopt;
    if (found->hasEntity) return scanner_->decodedValues_.emplace_back(XmlScanner::decoded(*found));
    return found->value;
}

std::optional<std::string> ScannedNode::text(std::string_view attributeName) const {
    const XmlScanner::Attribute* found = scanner_->find(depth_, attributeName);
    if (!found) return std::nullopt;
    return found->hasEntity ? XmlScanner::decoded(*found) : std::string(found->value);
}

void ScannedNode::takePlainPoints(ZephFixture& fixture) const {
    if (scanner_->open_ != depth_) return;
    for (;;) {
        scanner_->skipWhite();
        const char* at = scanner_->at_;
        std::int32_t slot = 0;
        ZephDrawPoint point;
        const auto into = [](std::int32_t& value) {
            return [&value](const char*& digits) { return takePlainLong(digits, value); };
        };
        const bool plain = passPlainPoint(at, into(slot), into(point.Type), into(point.X), into(point.Y));
        if (!plain || !fixture.DrawPoints.contains(slot)) return;
        fixture.PointCount = slot;
        fixture.DrawPoints[slot] = point;
        scanner_->at_ = at;
    }
}

XmlScanner::XmlScanner(std::string_view text)
    : begin_(text.data()), end_(text.data() + text.size()), at_(text.data()) {}

void XmlScanner::fail() noexcept {
    unusual_ = true;
    at_ = end_;
}

void XmlScanner::skipWhite() noexcept {
    constexpr std::uint64_t kEightBlanks = 0x2020202020202020;
    while (isWhite(*at_)) {
        ++at_;
        while (eightBytes(at_) == kEightBlanks)
            at_ += 8;
    }
}

bool XmlScanner::take(std::string_view expected) noexcept {
    if (!std::string_view(at_, static_cast<std::size_t>(end_ - at_)).starts_with(expected)) return false;
    at_ += expected.size();
    return true;
}

std::string_view XmlScanner::takeName() noexcept {
    const char* first = at_;
    if (!isClass(*at_, kNameStart)) return {};
    while (isClass(*at_, kNamePart))
        ++at_;
    return {first, static_cast<std::size_t>(at_ - first)};
}

ScannedNode XmlScanner::root() {
    if (!take("<?xml version='1.0' encoding='UTF-8'?>")) take("<?xml version=\"1.0\" encoding=\"UTF-8\"?>");
    skipWhite();
    rootName_ = static_cast<std::size_t>(at_ + 1 - begin_);
    return {*this, step() == Tag::Start ? 1 : 0};
}

bool XmlScanner::isUsual(std::string_view text) {
    XmlScanner scanner(text);
    if (!scanner.root()) return false;
    scanner.passOver(1);
    scanner.skipWhite();
    return !scanner.unusual_ && scanner.at_ == scanner.end_;
}

// Reads the next tag of the innermost open element, or the root's.
XmlScanner::Tag XmlScanner::step() {
    if (unusual_) return Tag::None;
    skipWhite();
    if (*at_ != '<') {
        fail();
        return Tag::None;
    }
    ++at_;
    if (*at_ == '/') {
        readEndTag();
        return unusual_ ? Tag::None : Tag::End;
    }
    readStartTag();
    return unusual_ ? Tag::None : Tag::Start;
}

void XmlScanner::readStartTag() {
    if (open_ == kMaxDepth) return fail();
    Frame& entered = frame(++open_);
    entered.name = takeName();
    entered.known = entered.attributeCount;
    entered.attributeCount = 0;
    entered.next = 0;
    if (entered.name.empty()) return fail();
    for (;;) {
        if (*at_ == '>') {
            ++at_;
            return;
        }
        if (*at_ == '/') {
            if (at_[1] != '>') return fail();
            at_ += 2;
            --open_;
            return;
        }
        if (*at_ != ' ') return fail();
        ++at_;
        if (!readAttribute(entered)) return fail();
    }
}

// The name and "=\"" behind it. False when it is none, or the second of its name, which makes the document no XML.
bool XmlScanner::takeAttributeName(Frame& entered, std::string_view& name) {
    const auto count = static_cast<std::size_t>(entered.attributeCount);
    if (entered.attributeCount < entered.known) {
        // As long as the names are those of the element before, they are names, and no two of them are equal.
        name = entered.attributes[count].name;
        const char* behind = at_ + name.size();
        if (end_ - at_ > static_cast<std::ptrdiff_t>(name.size()) && sameName(at_, name) && behind[0] == '=' &&
            behind[1] == '"') {
            at_ = behind + 2;
            return true;
        }
        entered.known = 0;
    }
    name = takeName();
    if (name.empty() || at_[0] != '=' || at_[1] != '"' || entered.attributeCount == kMaxAttributes) return false;
    at_ += 2;
    for (std::size_t earlier = 0; earlier < count; ++earlier) {
        if (entered.attributes[earlier].name == name) return false;
    }
    return true;
}

bool XmlScanner::readAttribute(Frame& entered) {
    std::string_view name;
    if (!takeAttributeName(entered, name)) return false;
    const char* first = at_;
    bool hasEntity = false;
    std::uint64_t seen = 0;
    for (;;) {
        at_ = endOfValuePart(at_, seen);
        if (*at_ != '&') break;
        const Entity* entity = findEntity({at_, static_cast<std::size_t>(end_ - at_)});
        if (!entity) return false;
        hasEntity = true;
        at_ += entity->spelling.size();
    }
    if (*at_ != '"') return false;
    const std::string_view value(first, static_cast<std::size_t>(at_ - first));
    if ((seen & (kEachByte * 0x80)) != 0 && !isDocumentText(value)) return false;
    entered.attributes[static_cast<std::size_t>(entered.attributeCount)] = {name, value, hasEntity};
    ++entered.attributeCount;
    ++at_;
    return true;
}

void XmlScanner::readEndTag() {
    ++at_;
    if (open_ == 0 || !take(frame(open_).name) || *at_ != '>') return fail();
    ++at_;
    --open_;
}

// Leaves the element of this depth and everything in it.
void XmlScanner::passOver(int depth) {
    while (open_ >= depth && !unusual_) {
        skipPlainPoints();
        step();
    }
}

void XmlScanner::skipPlainPoints() noexcept {
    for (;;) {
        skipWhite();
        const char* at = at_;
        const auto skip = [](const char*& digits) { return skipPlainLong(digits); };  // a pointer would not be inlined
        if (!passPlainPoint(at, skip, skip, skip, skip)) return;
        at_ = at;
    }
}

const XmlScanner::Attribute* XmlScanner::find(int depth, std::string_view attributeName) {
    Frame& searched = frame(depth);
    const auto sought = [&](const Attribute& attribute) {
        return attribute.name.size() == attributeName.size() && attribute.name.front() == attributeName.front() &&
               attribute.name == attributeName;
    };
    const auto begin = searched.attributes.begin();
    const auto end = begin + searched.attributeCount;
    auto found = std::find_if(begin + searched.next, end, sought);
    if (found == end) {
        const auto wrapped = begin + searched.next;
        found = std::find_if(begin, wrapped, sought);
        if (found == wrapped) return nullptr;
    }
    // Many a reader asks twice, whether it is there and what it is: so the next search begins at this one.
    searched.next = static_cast<int>(found - begin);
    return &*found;
}

std::string XmlScanner::decoded(const Attribute& attribute) {
    std::string text;
    for (std::string_view rest = attribute.value; !rest.empty();) {
        const std::size_t plain = std::min(rest.find('&'), rest.size());
        text.append(rest.substr(0, plain));
        rest.remove_prefix(plain);
        if (rest.empty()) break;
        const Entity* entity = findEntity(rest);  // there is one, or the attribute had not been read
        text.push_back(entity->meaning);
        rest.remove_prefix(entity->spelling.size());
    }
    return text;
}
