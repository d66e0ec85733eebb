#include "model/xml_scanner.h"

#include <array>
#include <cstring>

namespace {

enum : std::uint8_t { kNameStart = 1, kNamePart = 2, kValuePart = 4 };

constexpr std::array<std::uint8_t, 256> kClasses = [] {
    std::array<std::uint8_t, 256> classes{};
    for (unsigned code = 0x20; code < 256; ++code) {
        const bool letter = (code >= 'A' && code <= 'Z') || (code >= 'a' && code <= 'z') || code == '_';
        const bool digit = code >= '0' && code <= '9';
        const bool special = code == '"' || code == '&' || code == '<';
        classes[code] = static_cast<std::uint8_t>((letter ? kNameStart : 0) | (letter || digit ? kNamePart : 0) |
                                                  (special ? 0 : kValuePart));
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

struct Entity {
    std::string_view spelling;
    char meaning;
};
// The program writes no others; a name with another one is left to the general parser.
constexpr std::array kEntities{Entity{"&amp;", '&'},  Entity{"&lt;", '<'},    Entity{"&gt;", '>'},
                               Entity{"&quot;", '"'}, Entity{"&apos;", '\''}, Entity{"&#13;", '\r'},
                               Entity{"&#10;", '\n'}, Entity{"&#9;", '\t'}};

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
    if (found->hasEntity) scanner_->fail();  // a number or a flag with an entity in it: not worth a second spelling
    return found->value;
}

std::optional<std::string> ScannedNode::text(std::string_view attributeName) const {
    const XmlScanner::Attribute* found = scanner_->find(depth_, attributeName);
    if (!found) return std::nullopt;
    if (found->hasEntity) return scanner_->decoded(*found);
    return std::string(found->value);
}

void ScannedNode::takePlainPoints(ZephFixture& fixture) const {
    if (scanner_->open_ != depth_) return;
    for (;;) {
        scanner_->skipWhite();
        const char* at = scanner_->at_;
        std::int32_t slot = 0;
        ZephDrawPoint point;
        const auto takeLong = [&at](std::int32_t& value, const auto& before) {
            if (!startsWith(at, before)) return false;
            at += sizeof before - 1;
            return takePlainLong(at, value);
        };
        const bool plain = takeLong(slot, "<DrawPoint ID=\"") && takeLong(point.Type, "\" Type=\"") &&
                           takeLong(point.X, "\" X=\"") && takeLong(point.Y, "\" Y=\"") && startsWith(at, "\"/>");
        if (!plain || !fixture.DrawPoints.contains(slot)) return;
        fixture.PointCount = slot;
        fixture.DrawPoints[slot] = point;
        scanner_->at_ = at + 3;
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

bool XmlScanner::finish() {
    passOver(1);
    skipWhite();
    return !unusual_ && open_ == 0 && at_ == end_;
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
    entered.attributeCount = 0;
    entered.next = 0;
    if (entered.name.empty()) return fail();
    for (std::uint64_t seen = 0;;) {
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
        if (!readAttribute(entered, seen)) return fail();
    }
}

bool XmlScanner::readAttribute(Frame& entered, std::uint64_t& seen) {
    const std::string_view name = takeName();
    if (name.empty() || at_[0] != '=' || at_[1] != '"' || entered.attributeCount == kMaxAttributes) return false;
    at_ += 2;
    // The general parser takes the first of two equal names; one bit for each name seen spares comparing them all.
    const unsigned mix = static_cast<unsigned>(name.size() * 11 + static_cast<unsigned char>(name.front()) * 5u +
                                               static_cast<unsigned char>(name.back()));
    const std::uint64_t bit = std::uint64_t{1} << (mix & 63);
    const auto count = static_cast<std::size_t>(entered.attributeCount);
    if ((seen & bit) != 0) {
        for (std::size_t earlier = 0; earlier < count; ++earlier) {
            if (entered.attributes[earlier].name == name) return false;
        }
    }
    seen |= bit;
    const char* first = at_;
    bool hasEntity = false;
    for (;;) {
        while (isClass(*at_, kValuePart))
            ++at_;
        if (*at_ != '&') break;
        hasEntity = true;
        ++at_;
    }
    if (*at_ != '"') return false;
    entered.attributes[count] = {name, {first, static_cast<std::size_t>(at_ - first)}, hasEntity};
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
    while (open_ >= depth && !unusual_)
        step();
}

const XmlScanner::Attribute* XmlScanner::find(int depth, std::string_view attributeName) {
    Frame& searched = frame(depth);
    for (int tried = 0; tried < searched.attributeCount; ++tried) {
        const int candidate = (searched.next + tried) % searched.attributeCount;
        const Attribute& attribute = searched.attributes[static_cast<std::size_t>(candidate)];
        if (attribute.name != attributeName) continue;
        searched.next = candidate + 1 == searched.attributeCount ? 0 : candidate + 1;
        return &attribute;
    }
    return nullptr;
}

std::optional<std::string> XmlScanner::decoded(const Attribute& attribute) {
    std::string text;
    for (std::string_view rest = attribute.value; !rest.empty();) {
        const std::size_t plain = std::min(rest.find('&'), rest.size());
        text.append(rest.substr(0, plain));
        rest.remove_prefix(plain);
        if (rest.empty()) break;
        const auto entity = std::find_if(kEntities.begin(), kEntities.end(),
                                         [&](const Entity& known) { return rest.starts_with(known.spelling); });
        if (entity == kEntities.end()) {
            fail();
            return text;
        }
        text.push_back(entity->meaning);
        rest.remove_prefix(entity->spelling.size());
    }
    return text;
}
