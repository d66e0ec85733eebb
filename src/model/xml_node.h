// An element of a parsed document, and how the records are read from the attributes of any element. The readers of
// the records are written once, for every type that offers what XmlNode offers.
#pragma once

#include "util/failure.h"
#include "util/text.h"

#include <optional>
#include <pugixml.hpp>
#include <string>
#include <string_view>

class XmlNode {
public:
    explicit XmlNode(pugi::xml_node node) : node_(node) {}

    explicit operator bool() const { return !node_.empty(); }
    std::string_view name() const { return node_.name(); }

    // Elements only: text, comments and whatever else stands among the children carry nothing.
    XmlNode firstElement() const { return XmlNode(elementFrom(node_.first_child())); }
    XmlNode nextElement() const { return XmlNode(elementFrom(node_.next_sibling())); }

    // The value as it stands in the file; nothing when the attribute is not there. The name is a literal.
    std::optional<std::string_view> attribute(std::string_view attributeName) const {
        const pugi::xml_attribute found = node_.attribute(attributeName.data());
        if (!found) return std::nullopt;
        return found.value();
    }
    std::optional<std::string> text(std::string_view attributeName) const {
        const auto value = attribute(attributeName);
        if (!value) return std::nullopt;
        return std::string(*value);
    }

private:
    static pugi::xml_node elementFrom(pugi::xml_node node) {
        while (node && node.type() != pugi::node_element)
            node = node.next_sibling();
        return node;
    }

    pugi::xml_node node_;
};

// A required attribute. Throws Failure, with the caller's line, when it is missing or its text is no such value.
template <typename Node>
std::int32_t longAttribute(const Node& node, std::string_view name, SourceLine where = SourceLine::current()) {
    const auto text = node.attribute(name);
    require(text.has_value(), "A required attribute is missing", where);
    const auto value = parseLong(*text);
    require(value.has_value(), "An attribute is not a whole number of 32 bits", where);
    return *value;
}

template <typename Node>
bool flagAttribute(const Node& node, std::string_view name, SourceLine where = SourceLine::current()) {
    const auto text = node.attribute(name);
    require(text.has_value(), "A required attribute is missing", where);
    const auto value = parseFlag(*text);
    require(value.has_value(), "An attribute is neither True nor False", where);
    return *value;
}

template <typename Node>
std::string textAttribute(const Node& node, std::string_view name, SourceLine where = SourceLine::current()) {
    auto text = node.text(name);
    require(text.has_value(), "A required attribute is missing", where);
    return *std::move(text);
}

// The number of a record, 1..max.
template <typename Node>
int slotAttribute(const Node& node, int max, SourceLine where = SourceLine::current()) {
    const std::int32_t slot = longAttribute(node, "ID", where);
    require(slot >= 1 && slot <= max, "Subscript out of range", where);
    return slot;
}

template <typename Node>
std::int32_t longAttributeOr(const Node& node, std::string_view name, std::int32_t otherwise,
                             SourceLine where = SourceLine::current()) {
    return node.attribute(name) ? longAttribute(node, name, where) : otherwise;
}
