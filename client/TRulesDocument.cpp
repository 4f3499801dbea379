#include "client/TRulesDocument.h"

#include <cerrno>
#include <cstring>
#include <fstream>
#include <iterator>
#include <sstream>

#include "client/TClientError.h"
#include "host/TXmlParser.h"

namespace NORVZEL20 {

namespace {

// Follows the document as the plug-in's parser does, but keeps lines and minds no fault.
class TLineReader : public TXmlParser {
  public:
    explicit TLineReader(std::vector<TRulesDocument::TElement>& elements) : fElements(elements) {}

    void StartElement(const char* name, std::map<std::string, std::string>& attrs) override
    {
        const std::string element = name;
        if (element == "class") {
            AddElement(attrs);
        } else if (element == "includelist") {
            fTreatment = TCIMDiffEngine::INCLUDE;
        } else if (element == "excludelist") {
            fTreatment = TCIMDiffEngine::EXCLUDE;
        } else if (element == "value") {
            fText.clear();
        }
    }

    void EndElement(const char* name) override
    {
        if (std::strcmp(name, "value") == 0 && !fElements.empty()) {
            fElements.back().listed.push_back({fText, fTreatment, GetCurLine()});
        }
    }

    void characters(const char* text, unsigned int) override { fText += text; }

  private:
    void AddElement(std::map<std::string, std::string>& attrs)
    {
        TRulesDocument::TElement element;
        element.className = attrs["name"];
        if (attrs["default"] == "include") {
            element.defaultTreatment = TCIMDiffEngine::INCLUDE;
        }
        std::istringstream keys(attrs["excludekeys"]);
        element.excludedKeys.assign(std::istream_iterator<std::string>(keys), std::istream_iterator<std::string>());
        element.line = GetCurLine();
        fElements.push_back(element);
    }

    std::vector<TRulesDocument::TElement>& fElements;
    TCIMDiffEngine::propType fTreatment = TCIMDiffEngine::EXCLUDE;
    std::string fText;
};

std::string ReadWhole(const std::string& path)
{
    std::ifstream file(path, std::ios::binary);
    std::string text((std::istreambuf_iterator<char>(file)), std::istreambuf_iterator<char>());
    if (!file.is_open() || file.bad()) {
        throw TClientError(path + ": cannot be read: " + std::strerror(errno));
    }
    return text;
}

}  // namespace

TRulesDocument TRulesDocument::Read(const std::string& path)
{
    TRulesDocument document;
    std::string text = ReadWhole(path);
    TLineReader reader(document.elements);
    reader.Parse(&text[0], text.size());
    return document;
}

const TRulesDocument::TElement* TRulesDocument::FindByLine(unsigned int line) const
{
    const TElement* found = nullptr;
    for (const TElement& element : elements) {
        if (element.line <= line) {
            found = &element;
        }
    }
    return found;
}

}  // namespace NORVZEL20
