#include "model/checksum.h"
#include "tests/support/folder.h"
#include "util/failure.h"

namespace {

// The text without the attribute that was found, or "none".
std::string without(std::string text) {
    const std::size_t tag = text.find("Zeph");
    const auto found = findChecksumAttribute(text, tag);
    return found ? text.erase(found->begin, found->end - found->begin) : "none";
}

}  // namespace

TEST(Md5, GivesThePublishedValuesInUpperCase) {
    // The test suite of RFC 1321, appendix A.5.
    MD5Hash hash;
    EXPECT_EQ(hash.HashBytes(""), "D41D8CD98F00B204E9800998ECF8427E");
    hash.NewHash();
    hash.HashBlock("message ");
    hash.HashBlock("digest");
    EXPECT_EQ(hash.HashValue(), "F96B697D7CB7938D525A2F31AAF161D0");

    const Folder folder;
    const std::string spansBlocks(16384 + 1, 'x');
    folder.write("a", QByteArray::fromStdString(spansBlocks));
    EXPECT_EQ(MD5Hash().HashFile(folder.path("a")), hash.HashBytes(spansBlocks));
    EXPECT_THROW(hash.HashFile(folder.path("none")), Failure);
}

TEST(Checksum, HashesUtf16CodeUnitsThenTheSeedOrABlank) {
    std::string bytes;
    for (const char16_t unit : u"<a n=\"\u00e4\U0001F384\"/>" + std::u16string(u"20481973"))
        bytes.append({static_cast<char>(unit & 0xFF), static_cast<char>(unit >> 8)});
    MD5Hash hash;
    const std::string text = "<a n=\"\xC3\xA4\xF0\x9F\x8E\x84\" Chksum=\"X\"/>";
    const auto attribute = findChecksumAttribute(text, 1);
    ASSERT_TRUE(attribute);
    EXPECT_EQ(editorChecksum(text, *attribute, false), hash.HashBytes(bytes));
    bytes.resize(bytes.size() - 16);
    bytes.append(" \0", 2);
    EXPECT_EQ(editorChecksum(text, *attribute, true), hash.HashBytes(bytes));
}

TEST(Checksum, ACharacterMayLieAcrossTheBlocks) {
    // Three bytes a character: no block of a power of two ends between two of them, so every border cuts one.
    std::string text;
    while (text.size() < 200'000)
        text += "\xE2\x82\xAC";
    std::string units;
    for (std::size_t n = 0; n < text.size() / 3; ++n)
        units.append("\xAC\x20", 2);
    for (const char digit : std::to_string(kChecksumSeed))
        units.append({digit, '\0'});
    MD5Hash hash;
    EXPECT_EQ(editorChecksum(text, {0, 0}, false), hash.HashBytes(units));
}

TEST(Checksum, TheAttributeIsFoundInAnySpelling) {
    EXPECT_EQ(without("<Zeph a=\"1\" Chksum=\"X\">"), "<Zeph a=\"1\">");
    EXPECT_EQ(without("<Zeph Chksum=\"X\" a=\"1\">"), "<Zeph a=\"1\">");
    EXPECT_EQ(without("<Zeph a=\"1\"\r\n  Chksum = 'X'/>"), "<Zeph a=\"1\"/>");
    EXPECT_EQ(without("<Zeph a=' Chksum=\"no\" >' Chksum=\"X\"/>"), "<Zeph a=' Chksum=\"no\" >'/>");
    for (const char* none : {"<Zeph a=\"Chksum\">", "<Zeph>", "<Zeph/>", "<Zeph chksum=\"X\">", "<Zeph Chksum",
                             "<Zeph Chksum=", "<Zeph Chksum=\"X", "<Zeph XChksum=\"X\">", "<Zeph a Chksum=\"X\">"}) {
        EXPECT_EQ(without(none), "none") << none;
    }
}
