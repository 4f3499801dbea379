// Bytes that are no text, and text in another encoding than it declares.
#include <gmock/gmock.h>

#include "tests/hostile/HostileRow.h"

namespace NORVZEL20 {

namespace {

std::string BigEndian(const std::string& text)
{
    std::string wide;
    for (const char unit : text) {
        wide += std::string(1, '\0') + unit;
    }
    return wide;
}

std::string LittleEndian(const std::string& text)
{
    std::string wide;
    for (const char unit : text) {
        wide += std::string(1, unit) + '\0';
    }
    return wide;
}

std::string MarkedBigEndian(const std::string& text)
{
    return "\xFE\xFF" + BigEndian(text);
}

std::string MarkedLittleEndian(const std::string& text)
{
    return "\xFF\xFE" + LittleEndian(text);
}

std::string WithoutLastByte(const std::string& text)
{
    const std::string wide = MarkedLittleEndian(text);
    return wide.substr(0, wide.size() - 1);
}

std::string WithOneByteMore(const std::string& text)
{
    return MarkedBigEndian(text) + '\n';
}

/// A high surrogate that nothing follows, in the place of the first "I".
std::string WithLoneSurrogate(const std::string& text)
{
    std::string wide = MarkedBigEndian(text);
    const std::size_t place = wide.find(BigEndian(">Id<"));
    return wide.replace(place + 2, 2, "\xD8\x01");
}

std::string MarkedUtf8(const std::string& text)
{
    return "\xEF\xBB\xBF" + text;
}

THostileRow NotWellFormed(const std::string& name, const std::string& content, std::size_t offset)
{
    return Refused(name, {"", content}, offset, "not well-formed (invalid token)");
}

}  // namespace

TEST(EncodingTest, Utf16IsReadInBothByteOrders)
{
    ExpectOutcomes({Handled("big-endian, marked", {"", "Id", MarkedBigEndian}),
                    Handled("little-endian, marked", {"", "Id", MarkedLittleEndian}),
                    Handled("big-endian, unmarked", {"", "Id", BigEndian}),
                    Handled("little-endian, unmarked", {"", "Id", LittleEndian}),
                    Handled("declared", {"<?xml version=\"1.0\" encoding=\"UTF-16\"?>", "Id", MarkedLittleEndian}),
                    Handled("UTF-8, marked", {"", "Id", MarkedUtf8})});
}

TEST(EncodingTest, HalfACharacterIsRefused)
{
    THostileRow early = Refused("UTF-16 that ends early", {"", "Id", WithoutLastByte}, 74, "unclosed token");
    early.populator += "; the document ends within <CIM>, so it was cut off: fetch or write it again";
    ExpectOutcomes({early, Refused("UTF-16 and one byte", {"", "Id", WithOneByteMore}, 80, "unclosed token")});
}

// Which of the two depends on the library's version: older ones join the half with what follows it.
TEST(EncodingTest, HalfASurrogatePairIsRefusedOrReadAsOneCharacter)
{
    const auto row = Refused("half a surrogate pair", {"", "Id", WithLoneSurrogate}, 1, "not well-formed (invalid token)");
    EXPECT_THAT(row.document.ReadByParser().outcome, testing::AnyOf(row.parser, "1 elements, text '\xF0\x90\x91\xA4'"));
    EXPECT_THAT(row.document.LoadByPopulator().outcome, testing::AnyOf(row.populator, "loaded '\xF0\x90\x91\xA4'"));
}

TEST(EncodingTest, WrongDeclarationsAreRefused)
{
    const std::string declared = "<?xml version=\"1.0\" encoding=\"";
    const std::string contradicts = "encoding specified in XML declaration is incorrect";
    ExpectOutcomes({RefusedAt("UTF-8 that says UTF-16", {declared + "UTF-16\"?>", "Id"}, 31, contradicts),
                    RefusedAt("UTF-16 that says UTF-8", {declared + "UTF-8\"?>", "Id", MarkedLittleEndian}, 32, contradicts),
                    RefusedAt("an encoding that is not read", {declared + "UTF-32\"?>", "Id"}, 31, "unknown encoding"),
                    RefusedAt("an encoding that does not exist", {declared + "nobody\"?>", "Id"}, 31, "unknown encoding")});
}

TEST(EncodingTest, InvalidUtf8IsRefused)
{
    ExpectOutcomes({NotWellFormed("a continuation alone", "I\x80", 1), NotWellFormed("a byte that UTF-8 has not", "I\xFF", 1),
                    NotWellFormed("a slash of two bytes", "I\xC0\xAF", 1),
                    NotWellFormed("a slash of three bytes", "I\xE0\x80\xAF", 1), NotWellFormed("a surrogate", "I\xED\xA0\x80", 1),
                    NotWellFormed("beyond the last plane", "I\xF4\x90\x80\x80", 1),
                    NotWellFormed("two bytes of three", "I\xE2\x82", 1), NotWellFormed("in an attribute", "<a b='\x80'/>", 6),
                    NotWellFormed("in a name", "<\xC3\x28/>", 1), NotWellFormed("in a comment", "<!--\xFF-->", 4),
                    NotWellFormed("not a character", "I\xEF\xBF\xBE", 1)});
}

TEST(EncodingTest, ControlCharactersAreRefused)
{
    const std::string nul(1, '\0');
    const std::string number = "reference to invalid character number";
    ExpectOutcomes({NotWellFormed("NUL in text", "I" + nul + "d", 1), NotWellFormed("NUL in a name", "<a" + nul + "/>", 2),
                    NotWellFormed("NUL in an attribute", "<a b='" + nul + "'/>", 6),
                    NotWellFormed("NUL in CDATA", "<![CDATA[" + nul + "]]>", 9), NotWellFormed("bell", "\a", 0),
                    Refused("NUL by reference", {"", "&#0;"}, 0, number),
                    Refused("a surrogate by reference", {"", "&#xD800;"}, 0, number),
                    RefusedAt("NUL before the document", {nul, "Id"}, 2, "not well-formed (invalid token)")});
}

TEST(EncodingTest, BytesBehindTheDocumentAreRefused)
{
    const auto withNul = [](const std::string& text) { return text + '\0'; };
    const auto withText = [](const std::string& text) { return text + "x"; };
    ExpectOutcomes({Refused("NUL behind the document", {"", "Id", withNul}, 79, "not well-formed (invalid token)"),
                    Refused("text behind", {"", "Id", withText}, 79, "junk after document element")});
}

}  // namespace NORVZEL20
