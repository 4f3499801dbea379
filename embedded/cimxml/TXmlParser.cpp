// The host's XML parser for other libraries: the events of TXmlReader as calls of virtual operations.
//
// Attributes become a map, and text is handed over with the next tag or when the derived class asks for it. A document in error
// ends with one call of FatalError; an exception of the derived class passes through Parse as it was.
#include "host/TXmlParser.h"

#include <cstring>

#include "embedded/cimxml/TXmlReader.h"

namespace NORVZEL20 {

/// Turns the reader's events into calls on the parser.
class TXmlParser::TEvents : public IXmlSink {
  public:
    explicit TEvents(TXmlParser& parser) : fParser(parser), fReader(*this) {}

    void OnStart(const char* name, const char** attributes) override
    {
        fParser.ParseCharData();
        fAttributes.clear();
        for (const char** next = attributes; *next != nullptr; next += 2) {
            fAttributes.emplace(next[0], next[1]);
        }
        fParser.StartElement(name, fAttributes);
    }

    void OnEnd(const char* name) override
    {
        fParser.ParseCharData();
        fParser.EndElement(name);
    }

    /// The parser gets text when it asks for it, at the latest before the next tag.
    void OnText(const char* text, std::size_t length) override
    {
        fText = text;
        fLength = length;
    }

    void OnProcessingInstruction(const char* target, const char* data) override { fParser.processingInstruction(target, data); }

    void OnNotation(const char* name, const char* publicId, const char* systemId) override
    {
        fParser.notationDecl(name, publicId, systemId);
    }

    void HandOverText()
    {
        if (fLength == 0) {
            return;
        }
        // The text is forgotten before the call: a handler that asks for it again must not get it twice.
        const std::size_t length = fLength;
        fLength = 0;
        fParser.characters(fText, static_cast<unsigned int>(length));
    }

    void Parse(const char* text, std::size_t length)
    {
        fReader.Reset();
        fLength = 0;
        // An exception of a handler leaves Parse here and is not reported as an error of the document.
        if (!fReader.Parse(text, length, true)) {
            fParser.FatalError(fReader.GetError().c_str());
        }
    }

    const TXmlReader& GetReader() const noexcept { return fReader; }

  private:
    TXmlParser& fParser;
    TXmlReader fReader;
    std::map<std::string, std::string> fAttributes;
    const char* fText = nullptr;  // not handed over yet; the reader keeps it until the next tag
    std::size_t fLength = 0;
};

TXmlParser::TXmlParser() : fEvents(new TEvents(*this)) {}

TXmlParser::~TXmlParser() = default;

void TXmlParser::StartElement(const char*, std::map<std::string, std::string>&) {}

void TXmlParser::EndElement(const char*) {}

void TXmlParser::processingInstruction(const char*, const char*) {}

void TXmlParser::characters(const char*, unsigned int) {}

void TXmlParser::notationDecl(const char*, const char*, const char*) {}

void TXmlParser::FatalError(const char*) {}

void TXmlParser::ParseJSSP() {}

void TXmlParser::ParseCharData()
{
    fEvents->HandOverText();
}

void TXmlParser::Parse(char* text)
{
    Parse(text, std::strlen(text));
}

void TXmlParser::Parse(char* text, std::size_t length)
{
    fEvents->Parse(text, length);
}

unsigned int TXmlParser::GetCurLine() const
{
    return static_cast<unsigned int>(fEvents->GetReader().GetPlace().line);
}

unsigned int TXmlParser::GetCurColumn() const
{
    return static_cast<unsigned int>(fEvents->GetReader().GetPlace().column);
}

}  // namespace NORVZEL20
