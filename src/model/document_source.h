// From a file's text to its root element, for every kind of file: by the scanner where the text is spelled as the
// program spells it, by the general parser otherwise.
#pragma once

#include "model/source_text.h"
#include "model/xml_check.h"
#include "model/xml_node.h"
#include "model/xml_scanner.h"

#include <new>

// How a text is read. The quick form gives up on unusual spellings and reads nothing then; the general form reads
// them all. Where the quick form does read, both give the same records, messages and reports.
enum class TextReading { QuickThenGeneral, GeneralOnly, QuickOnly };

enum class RootReading { Used, Unusual, Malformed };  // Unusual: only where the general form was not allowed

// Calls use(root, rootName) with the root element, a ScannedNode or an XmlNode; rootName is the offset of its name in
// the text. before(root, rootName) is called ahead of the first look at the whole text; it returns whether the text
// is UTF-8 that must stay where it is, otherwise the text is decoded in its place.
template <typename Before, typename Use>
RootReading readRoot(SourceText& text, TextReading reading, Before before, Use use) {
    bool stays = false;
    if (reading != TextReading::GeneralOnly) {
        XmlScanner scanner(text.view());
        const ScannedNode root = scanner.root();
        const std::size_t rootName = scanner.rootNameOffset();
        if (root) stays = before(root, rootName);
        if (root && XmlScanner::isUsual(text.view())) {
            use(root, rootName);
            return RootReading::Used;
        }
        if (reading == TextReading::QuickOnly) return RootReading::Unusual;
    }
    if (!stays && !decodeSource(text)) return RootReading::Malformed;
    if (!checkXml(text)) return RootReading::Malformed;  // a text that stays has no DOCTYPE and is not changed
    pugi::xml_document document;
    const std::string_view utf8 = text.view();
    const pugi::xml_parse_result parsed =
        document.load_buffer(utf8.data(), utf8.size(), pugi::parse_default, pugi::encoding_utf8);
    if (parsed.status == pugi::status_out_of_memory) throw std::bad_alloc();
    const pugi::xml_node root = document.document_element();
    if (!parsed || !root) return RootReading::Malformed;
    use(XmlNode(root), static_cast<std::size_t>(root.offset_debug()));
    return RootReading::Used;
}
