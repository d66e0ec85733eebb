// Reads a document's text in one pass, without building a tree, as long as it is spelled the way the program writes
// it: elements, double-quoted attributes and white space, nothing else. Whatever is spelled otherwise (a comment, a
// DOCTYPE, an unknown entity, a repeated attribute, an unclosed tag) makes the text unusual, and it is for the general
// parser. What the scan delivers of a usual text is exactly what that parser would have delivered.
#pragma once

#include "model/simulation.h"

#include <array>
#include <cstdint>
#include <deque>
#include <optional>
#include <string>
#include <string_view>

class XmlScanner;

// The element that the scanner last entered on its level. It is read once, front to back: attributes first, then its
// children in order; nextElement passes over whatever of the element was not read.
class ScannedNode {
public:
    ScannedNode(XmlScanner& scanner, int depth) : scanner_(&scanner), depth_(depth) {}

    explicit operator bool() const { return depth_ > 0; }
    std::string_view name() const;
    ScannedNode firstElement() const;
    ScannedNode nextElement() const;
    std::optional<std::string_view> attribute(std::string_view attributeName) const;
    std::optional<std::string> text(std::string_view attributeName) const;

    // Takes the points that follow next in the one spelling that nearly all have, straight into the fixture, and stops
    // before the first one that differs in any way. Nine tenths of a large display are points.
    void takePlainPoints(ZephFixture& fixture) const;

private:
    XmlScanner* scanner_;
    int depth_;  // 1 = the root; 0 = no element
};

class XmlScanner {
public:
    // text must stay, with SourceText::kSlack zero bytes behind it.
    explicit XmlScanner(std::string_view text);

    // Whether the scanner can read the whole text: to be asked first, for a text may turn out malformed at its very
    // end, when its records are read already. Takes a third of the time of the reading.
    static bool isUsual(std::string_view text);

    // Enters the root element; no element when the beginning of the text is unusual.
    ScannedNode root();
    std::size_t rootNameOffset() const noexcept { return rootName_; }

private:
    friend class ScannedNode;

    static constexpr int kMaxDepth = 8;
    static constexpr int kMaxAttributes = 32;

    struct Attribute {
        std::string_view name;
        std::string_view value;
        bool hasEntity;
    };
    struct Frame {
        std::string_view name;
        std::array<Attribute, kMaxAttributes> attributes;
        int attributeCount = 0;
        int known = 0;  // names that still stand in attributes from the element before, which most often has the same
        int next = 0;   // readers ask in the written order, so the last one found and those behind it are tried first
    };
    enum class Tag { Start, End, None };

    void fail() noexcept;
    void skipWhite() noexcept;
    bool take(std::string_view expected) noexcept;
    std::string_view takeName() noexcept;
    Tag step();
    void readStartTag();
    void readEndTag();
    bool readAttribute(Frame& entered);
    bool takeAttributeName(Frame& entered, std::string_view& name);
    void passOver(int depth);
    const Attribute* find(int depth, std::string_view attributeName);
    void skipPlainPoints() noexcept;
    static std::string decoded(const Attribute& attribute);

    Frame& frame(int depth) noexcept { return frames_[static_cast<std::size_t>(depth)]; }

    const char* begin_;
    const char* end_;
    const char* at_;
    std::size_t rootName_ = 0;
    int open_ = 0;  // how many elements are open; the innermost is frame open_
    bool unusual_ = false;
    std::array<Frame, kMaxDepth + 1> frames_;
    std::deque<std::string> decodedValues_;  // of numbers and flags with an entity in them
};
