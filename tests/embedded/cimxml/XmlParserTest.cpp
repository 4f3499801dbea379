#include <gtest/gtest.h>

#include <stdexcept>
#include <string>

#include "host/TXmlParser.h"

namespace NORVZEL20 {
namespace {

/// Writes down the events; throws at an element called "throw".
class TRecorder : public TXmlParser {
  public:
    void StartElement(const char* name, std::map<std::string, std::string>& attrs) override
    {
        if (std::string(name) == "throw") {
            throw std::runtime_error("thrown");
        }
        fEvents += std::string("<") + name;
        for (const auto& [key, value] : attrs) {
            fEvents += " " + key + "=" + value;
        }
        fEvents += ">";
    }
    void EndElement(const char* name) override { fEvents += std::string("</") + name + ">"; }
    void characters(const char* text, unsigned int length) override
    {
        EXPECT_EQ('\0', text[length]);
        fEvents += "[" + std::string(text, length) + "]";
    }
    void processingInstruction(const char* target, const char* data) override
    {
        fEvents += std::string("?") + target + " " + data + "?";
    }
    void notationDecl(const char* name, const char*, const char* systemId) override
    {
        fEvents += std::string("!") + name + " " + systemId + "!";
    }
    void FatalError(const char* message) override
    {
        fEvents += "{" + std::to_string(GetCurLine()) + ":" + std::to_string(GetCurColumn()) + " " + message + "}";
    }

    std::string EventsOf(std::string document)
    {
        fEvents.clear();
        Parse(document.data(), document.size());
        return fEvents;
    }

  private:
    std::string fEvents;
};

TEST(XmlParserTest, TextBetweenTwoTagsComesWhole)
{
    TRecorder recorder;
    EXPECT_EQ("<a>[x\n<&y z]<b></b>[t]</a>",
              recorder.EventsOf("<!DOCTYPE a [<!ENTITY e \"y\">]><a>x\n&lt;&amp;&e;<!-- no --><![CDATA[ z]]><b/>t</a>"));
}

TEST(XmlParserTest, AttributesComeAsAMap)
{
    TRecorder recorder;
    EXPECT_EQ("<a k=1 l=\"></a>", recorder.EventsOf("<a l='&quot;' k='1'/>"));
}

TEST(XmlParserTest, InstructionsAndNotationsAreReported)
{
    TRecorder recorder;
    EXPECT_EQ("!n s!?t d?<a></a>", recorder.EventsOf("<!DOCTYPE a [<!NOTATION n SYSTEM 's'>]><?t d?><a/>"));
}

TEST(XmlParserTest, WhatIsNotWellFormedIsReportedOnceWithItsPlace)
{
    const struct {
        std::string document;
        const char* events;
    } rows[] = {
        {"", "{1:1 no element found}"},
        {"<a>\n</b>", "<a>{2:3 mismatched tag}"},
        {"<a>&u;</a>", "<a>{1:4 undefined entity}"},
        {std::string("<a>\0</a>", 8), "<a>{1:4 not well-formed (invalid token)}"},
        {"<a>\xFF</a>", "<a>{1:4 not well-formed (invalid token)}"},
        {"<a/><b/>", "<a></a>{1:5 junk after document element}"},
        {"<?xml version='1.0' encoding='x-none'?><a/>", "{1:31 unknown encoding}"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.events, TRecorder().EventsOf(row.document)) << row.document;
    }
}

TEST(XmlParserTest, TheEncodingsAreRead)
{
    EXPECT_EQ("<a>[\xC3\xBC]</a>", TRecorder().EventsOf("<a>\xC3\xBC</a>"));
    EXPECT_EQ("<a>[\xC3\xBC]</a>", TRecorder().EventsOf("<?xml version='1.0' encoding='ISO-8859-1'?><a>\xFC</a>"));
    EXPECT_EQ("<a>[x]</a>", TRecorder().EventsOf("<?xml version='1.0' encoding='US-ASCII'?><a>x</a>"));
    EXPECT_EQ("<a>[\xC3\xBC]</a>", TRecorder().EventsOf(std::string("\xFE\xFF\0<\0a\0>\0\xFC\0<\0/\0a\0>", 18)));
}

TEST(XmlParserTest, AnExceptionOfAHandlerEndsTheParseAsItWasThrown)
{
    TRecorder recorder;
    try {
        recorder.EventsOf("<a>\n<throw/><b/></a>");
        FAIL();
    } catch (const std::runtime_error& error) {
        EXPECT_STREQ("thrown", error.what());
    }
    EXPECT_EQ(2u, recorder.GetCurLine());
    EXPECT_EQ("<c></c>", recorder.EventsOf("<c/>"));
}

TEST(XmlParserTest, ExternalEntitiesAreRefused)
{
    EXPECT_EQ("<a>{1:51 external entities are not read}",
              TRecorder().EventsOf("<!DOCTYPE a [<!ENTITY e SYSTEM \"/etc/passwd\">]><a>&e;</a>"));
}

TEST(XmlParserTest, DepthAndAttributesAreBounded)
{
    std::string deep;
    for (int level = 0; level < 10001; ++level) {
        deep += "<a>";
    }
    const std::string events = TRecorder().EventsOf(deep);
    EXPECT_EQ("{1:30001 elements are nested too deeply}", events.substr(events.find('{')));
    std::string wide = "<a";
    for (int number = 0; number < 1001; ++number) {
        wide += " k" + std::to_string(number) + "=''";
    }
    EXPECT_EQ("{1:1 too many attributes}", TRecorder().EventsOf(wide + "/>"));
}

TEST(XmlParserTest, TextUpToItsNulIsParsed)
{
    TRecorder recorder;
    std::string document = "<a/>";
    recorder.Parse(document.data());
    EXPECT_EQ(1u, recorder.GetCurLine());
}

}  // namespace
}  // namespace NORVZEL20
