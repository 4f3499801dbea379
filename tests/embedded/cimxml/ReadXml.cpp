#include "tests/embedded/cimxml/ReadXml.h"

#include <algorithm>
#include <utility>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/cimxml/TCimXmlWriter.h"
#include "embedded/load/TPopulateError.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

namespace {

/// Whether a piece ends with a carriage return behind the last end tag. Versions of Expat differ in how many lines they count
/// there.
bool EndsLineBehindRoot(std::string_view document, std::size_t piece)
{
    const std::size_t endTag = document.rfind("</");
    for (std::size_t at = 0; piece != 0 && at < document.size();) {
        at = std::min(at + piece, document.size());
        if ((endTag == std::string_view::npos || at > endTag) && document[at - 1] == '\r') {
            return true;
        }
    }
    return false;
}

/// Writes down the events.
class TEventLog : public IXmlSink {
  public:
    TEventLog(TXmlReader::EParser parser, bool isSequence) : fReader(*this, parser)
    {
        if (isSequence) {
            fReader.ReadSequence();
        }
    }

    void OnStart(const char* name, const char** attributes) override
    {
        ++fDepth;
        Add("<", name);
        for (const char** next = attributes; *next != nullptr; next += 2) {
            Add(" ", next[0]);
            Add("=", next[1]);
        }
        AddPlace();
    }
    void OnEnd(const char* name) override
    {
        Add("</", name);
        AddPlace();
        --fDepth;
    }
    void OnText(const char* text, std::size_t length) override
    {
        Add(text[length] == '\0' ? "[" : "not ended[", std::string_view(text, length));
        AddPlace();
    }
    void OnProcessingInstruction(const char* target, const char* data) override
    {
        Add("?", target);
        Add(" ", data);
        AddPlace();
    }

    void Read(std::string_view document, std::size_t piece)
    {
        fHasLineEndBehindRoot = EndsLineBehindRoot(document, piece);
        const bool isRead = piece == 0       ? fReader.Parse(document.data(), document.size(), true)
                            : piece % 2 == 0 ? ReadPieces(document, piece)
                                             : ReadBuffers(document, piece);
        Add(isRead ? "read" : "not read: ", fReader.GetError());
        AddPlace();
    }

    TXmlOutcome TakeOutcome() { return {std::move(fText), fReader.CountTokens(), fReader.HasLeftToExpat()}; }

  private:
    void Add(std::string_view mark, std::string_view text) { fText.append(mark).append(text); }
    void AddPlace()
    {
        if (fHasLineEndBehindRoot && fDepth == 0) {
            return;
        }
        const TTextPlace place = fReader.GetPlace();
        fText += " @" + std::to_string(place.line) + ":" + std::to_string(place.column) + "\n";
    }

    /// Each piece is a copy of its own, so a sanitizer sees whoever reads beyond it.
    bool ReadPieces(std::string_view document, std::size_t piece)
    {
        for (; !document.empty(); document.remove_prefix(std::min(piece, document.size()))) {
            const std::string copy(document.substr(0, piece));
            if (!fReader.Parse(copy.data(), copy.size())) {
                return false;
            }
        }
        return fReader.Finish();
    }

    bool ReadBuffers(std::string_view document, std::size_t piece)
    {
        while (!document.empty()) {
            const std::size_t length = document.copy(fReader.GetBuffer(piece), piece);
            document.remove_prefix(length);
            if (!fReader.ParseBuffer(length)) {
                return false;
            }
        }
        return fReader.Finish();
    }

    TXmlReader fReader;
    std::string fText;
    int fDepth = 0;  // of open elements
    bool fHasLineEndBehindRoot = false;
};

}  // namespace

TXmlOutcome ReadXml(std::string_view document, std::size_t piece, TXmlReader::EParser parser, bool isSequence)
{
    TEventLog log(parser, isSequence);
    log.Read(document, piece);
    return log.TakeOutcome();
}

std::string LoadXml(std::string_view document, std::size_t piece, TXmlReader::EParser parser)
{
    const boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
    TCimXmlPopulator populator(ns);
    if (parser == TXmlReader::EParser::kExpat) {
        populator.UseExpatAlone();
    }
    const auto source = [&document, piece](char* buffer, std::size_t size) {
        const std::size_t length = document.copy(buffer, std::min(size, piece));
        document.remove_prefix(length);
        return length;
    };
    try {
        const TLoadReport report = piece == 0 ? populator.LoadFromMemory(document.data(), document.size(), "xml")
                                              : populator.LoadFromSource(source, "xml");
        std::string text;
        TCimXmlWriter([&text](std::string_view part) { text += part; }).WriteNamespace(*ns);
        for (const TLoadReport::TTolerated& tolerated : report.tolerated) {
            text += std::to_string(tolerated.line) + ": " + tolerated.text + "\n";
        }
        return text;
    } catch (const TPopulateError& error) {
        return error.what();
    }
}

}  // namespace NORVZEL20
