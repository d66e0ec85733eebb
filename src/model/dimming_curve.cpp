#include "model/dimming_curve.h"

#include "model/source_text.h"
#include "model/xml_check.h"
#include "model/xml_node.h"

#include <numeric>

namespace {

constexpr std::string_view kModule = "modZephLoadSave";

std::size_t byteAttribute(const XmlNode& node, std::string_view name, SourceLine where = SourceLine::current()) {
    const std::int32_t value = longAttribute(node, name, where);
    require(value >= 0 && value <= 255, "A value of the curve is not in 0..255", where);
    return static_cast<std::size_t>(value);
}

void readCurve(SourceText text, FailureReport& failures, ZephDimmingCurve& curve) {
    pugi::xml_document document;
    const bool decoded = decodeSource(text) && checkXml(text);
    const std::string_view utf8 = text.view();
    const bool parsed =
        decoded && document.load_buffer(utf8.data(), utf8.size(), pugi::parse_default, pugi::encoding_utf8);
    const pugi::xml_node root = document.document_element();
    require(parsed && root, "The Dimming Curve file is invalid or corrupted.");
    require(std::string_view(root.name()) == "ZephDimCurve", "This is not a valid Dimming Curve for this application.");
    require(std::string_view(root.attribute("zephSaveFileVersion").value()) == "1.5.0",
            "The File Version for the dimming curve is incompatible for this application.");
    require(LoadDimmingCurveVersion150(root, failures, curve), "Could Not load the dimming curve's body.");
}

}  // namespace

ZephDimmingCurve ZephCreateDummyDimmingCurve() {
    ZephDimmingCurve curve;
    std::iota(curve.begin(), curve.end(), std::uint8_t{0});
    return curve;
}

bool ZephLoadDimmingCurveXML(const std::string& path, FailureReport& failures, ZephDimmingCurve& curve) try {
    SourceText text;
    require(readWholeFile(path, text) == FileReading::Read, "The Dimming Curve file is missing or invalid.");
    readCurve(std::move(text), failures, curve);
    return true;
}
ZEPH_GUARD(failures, kModule, false)

bool loadDimmingCurveText(std::string_view text, FailureReport& failures, ZephDimmingCurve& curve) try {
    readCurve(SourceText(text), failures, curve);
    return true;
}
ZEPH_GUARD(failures, kModule, false)

bool LoadDimmingCurveVersion150(const pugi::xml_node& root, FailureReport& failures, ZephDimmingCurve& curve) try {
    const pugi::xml_node body = root.child("Dimming_Curve");
    require(!body.empty(), "The curve has no Dimming_Curve element");
    for (XmlNode point = XmlNode(body).firstElement(); point; point = point.nextElement()) {
        const std::size_t input = byteAttribute(point, "ID");
        curve[input] = static_cast<std::uint8_t>(byteAttribute(point, "Value"));
    }
    return true;
}
ZEPH_GUARD(failures, kModule, false)
