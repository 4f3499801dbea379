// Bytes that are no text, and text in other encodings than it says.
#include "tests/hostile/HostileRow.h"

namespace NORVZEL20 {

namespace {

std::string BigEndian(const std::string& text)
{
    std::string wide;
    for (const char unit : text)
        wide += std::string(1, '\0') + unit;
    return wide;
}

std::string LittleEndian(const std::string& text)
{
    std::string wide;
    for (const char unit : text)
        wide += std::string(1, unit) + '\0';
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

THostileRow Handled(const std::string& name, const THostileDocument& document)
{
    return {name, document, "1 elements, text 'Id'", "loaded 'Id'", "rules for 'Id'"};
}

THostileRow NotWellFormed(const std::string& name, const std::string& content, const std::string& place)
{
    return Refused(name, {"", content}, 1, "not well-formed (invalid token)", place);
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
    ExpectOutcomes({Refused("UTF-16 that ends early", {"", "Id", WithoutLastByte}, 1, "unclosed token", "1:0"),
                    Refused("UTF-16 and one byte", {"", "Id", WithOneByteMore}, 1, "unclosed token", "1:0"),
                    Refused("half a surrogate pair", {"", "Id", WithLoneSurrogate}, 1, "not well-formed (invalid token)", "1:0")});
}

TEST(EncodingTest, WrongDeclarationsAreRefused)
{
    ExpectOutcomes({Refused("UTF-8 that says UTF-16", {"<?xml version=\"1.0\" encoding=\"UTF-16\"?>", "Id"}, 1,
                            "encoding specified in XML declaration is incorrect", "1:0"),
                    Refused("UTF-16 that says UTF-8", {"<?xml version=\"1.0\" encoding=\"UTF-8\"?>", "Id", MarkedLittleEndian}, 1,
                            "encoding specified in XML declaration is incorrect", "1:0"),
                    Refused("an encoding that is not read", {"<?xml version=\"1.0\" encoding=\"UTF-32\"?>", "Id"}, 1,
                            "unknown encoding", "1:0"),
                    Refused("an encoding that nobody knows", {"<?xml version=\"1.0\" encoding=\"nobody\"?>", "Id"}, 1,
                            "unknown encoding", "1:0")});
}

TEST(EncodingTest, InvalidUtf8IsRefused)
{
    ExpectOutcomes(
        {NotWellFormed("a continuation alone", "I\x80", "1:0"), NotWellFormed("a byte that UTF-8 has not", "I\xFF", "1:0"),
         NotWellFormed("a slash of two bytes", "I\xC0\xAF", "1:0"), NotWellFormed("a slash of three bytes", "I\xE0\x80\xAF", "1:0"),
         NotWellFormed("a surrogate", "I\xED\xA0\x80", "1:0"), NotWellFormed("beyond the last plane", "I\xF4\x90\x80\x80", "1:0"),
         NotWellFormed("two bytes of three", "I\xE2\x82", "1:0"), NotWellFormed("in an attribute", "<a b='\x80'/>", "1:0"),
         NotWellFormed("in a name", "<\xC3\x28/>", "1:0"), NotWellFormed("in a comment", "<!--\xFF-->", "1:0"),
         NotWellFormed("not a character", "I\xEF\xBF\xBE", "1:0")});
}

TEST(EncodingTest, ControlCharactersAreRefused)
{
    const std::string nul(1, '\0');
    ExpectOutcomes({NotWellFormed("NUL in text", "I" + nul + "d", "1:0"), NotWellFormed("NUL in a name", "<a" + nul + "/>", "1:0"),
                    NotWellFormed("NUL in an attribute", "<a b='" + nul + "'/>", "1:0"),
                    NotWellFormed("NUL in CDATA", "<![CDATA[" + nul + "]]>", "1:0"), NotWellFormed("bell", "\a", "1:0"),
                    Refused("NUL by reference", {"", "&#0;"}, 1, "reference to invalid character number", "1:0"),
                    Refused("a surrogate by reference", {"", "&#xD800;"}, 1, "reference to invalid character number", "1:0"),
                    Refused("NUL before the document", {nul, "Id"}, 1, "not well-formed (invalid token)", "1:0")});
}

/// The parser's entry that takes a pointer alone stops at the first NUL; bytes behind it are not its concern.
TEST(EncodingTest, BytesBehindTheDocumentAreRefused)
{
    ExpectOutcomes({Refused("NUL behind the document", {"", "Id", [](const std::string& text) { return text + '\0'; }}, 1,
                            "not well-formed (invalid token)", "1:0"),
                    Refused("another document behind", {"", "Id", [](const std::string& text) { return text + text; }}, 1,
                            "junk after document element", "1:0")});
}

}  // namespace NORVZEL20
