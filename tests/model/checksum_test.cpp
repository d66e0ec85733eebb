#include "model/checksum.h"
#include "tests/support/loading.h"
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
    MD5Hash hash;
    const std::string text = "<a n=\"\xC3\xA4\xF0\x9F\x8E\x84\" Chksum=\"X\"/>";
    const std::u16string units = u"<a n=\"\u00e4\U0001F384\"/>";
    const auto attribute = findChecksumAttribute(text, 1);
    ASSERT_TRUE(attribute);
    EXPECT_EQ(editorChecksum(text, *attribute, false), hash.HashBytes(utf16Bytes(units + u"20481973")));
    EXPECT_EQ(editorChecksum(text, *attribute, true), hash.HashBytes(utf16Bytes(units + u" ")));

    // Three bytes a character: no block of a power of two ends between two of them, so every border cuts one.
    std::string signs;
    for (int n = 0; n < 70'000; ++n)
        signs += "\xE2\x82\xAC";
    const std::u16string signUnits(70'000, u'\u20AC');
    EXPECT_EQ(editorChecksum(signs, {0, 0}, false), hash.HashBytes(utf16Bytes(signUnits + u"20481973")));
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
