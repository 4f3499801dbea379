#include <gtest/gtest.h>

#include "client/report/html/Base64.h"
#include "client/report/html/Sha256.h"
#include "client/report/html/TPackedText.h"
#include "client/report/html/TPageTexts.h"
#include "tests/client/report/html/Unpack.h"

namespace NORVZEL20 {
namespace {

TEST(Sha256Test, DigestsAreThoseOfTheStandard)
{
    const std::pair<std::string, std::string> kDigests[] = {
        {"", "e3b0c44298fc1c149afbf4c8996fb92427ae41e4649b934ca495991b7852b855"},
        {"abc", "ba7816bf8f01cfea414140de5dae2223b00361a396177a9cb410ff61f20015ad"},
        {"abcdbcdecdefdefgefghfghighijhijkijkljklmklmnlmnomnopnopq",
         "248d6a61d20638b8e5c026930c3e6039a33ce45964ff2167f6ecedd419db06c1"},
        {std::string(1000000, 'a'), "cdc76e5c9914fb9281a1c7e284d73e67f1809a48a497200e046d39ccc7112cd0"}};
    for (const auto& [text, digest] : kDigests) {
        EXPECT_EQ(digest, Sha256Hex(text)) << text.substr(0, 60);
    }
}

TEST(Base64Test, BytesAreWrittenInGroupsOfThreeWithPadding)
{
    const std::pair<std::string, std::string> kTexts[] = {{"", ""},
                                                          {"f", "Zg=="},
                                                          {"fo", "Zm8="},
                                                          {"foo", "Zm9v"},
                                                          {"foobar", "Zm9vYmFy"},
                                                          {"\xfb\xff\xbf", "+/+/"},
                                                          {std::string(1, '\0'), "AA=="}};
    for (const auto& [bytes, text] : kTexts) {
        EXPECT_EQ(text, EncodeBase64(bytes));
    }
}

std::string Pack(const std::vector<std::string>& pieces)
{
    std::string packed;
    const TTextSink sink = [&packed](std::string_view piece) { packed += piece; };
    TPackedText text(sink);
    for (const std::string& piece : pieces) {
        text.Add(piece);
    }
    text.End();
    return packed;
}

TEST(PackedTextTest, WhatWasPackedComesBackWhole)
{
    std::string noise;
    for (unsigned i = 0; i < 200000; ++i) {
        noise += static_cast<char>(i * 2654435761U >> 24U);
    }
    EXPECT_EQ("", Unpack(Pack({})));
    EXPECT_EQ("</script>one", Unpack(Pack({"</script>", "", "one"})));
    EXPECT_EQ(noise + noise, Unpack(Pack({noise, noise})));
}

TEST(PackedTextTest, TheSameBytesGiveTheSameTextWithoutMarkup)
{
    const std::string packed = Pack({"<script>", "x"});
    EXPECT_EQ(packed, Pack({"<script>", "x"}));
    EXPECT_EQ(std::string::npos, packed.find_first_of("<>&\"'"));
}

std::string WholeOf(const TSpooledText& spooled)
{
    std::string whole;
    spooled.ForEachPiece([&whole](std::string_view piece) { whole += piece; });
    return whole;
}

TEST(PageTextsTest, EachTextIsHeldOnceAndItsLengthIsThatOfUtf16)
{
    TPageTexts texts;
    EXPECT_EQ(0u, texts.Add(""));
    EXPECT_EQ(1u, texts.Add("a\xc3\xa4\xe2\x82\xac"));
    EXPECT_EQ(2u, texts.Add("\xf0\x9f\x98\x80"));
    EXPECT_EQ(1u, texts.Add("a\xc3\xa4\xe2\x82\xac"));
    EXPECT_EQ(3u, texts.GetCount());
    EXPECT_EQ("a\xc3\xa4\xe2\x82\xac\xf0\x9f\x98\x80", WholeOf(texts.GetTexts()));
    EXPECT_EQ(std::string("\0\0\0\0\3\0\0\0\2\0\0\0", 12), WholeOf(texts.GetLengths()));
}

TEST(PageTextsTest, BytesThatAreNotUtf8AreEscaped)
{
    TPageTexts texts;
    texts.Add("caf\xe9");
    EXPECT_EQ("caf\\xe9", WholeOf(texts.GetTexts()));
}

}  // namespace
}  // namespace NORVZEL20
