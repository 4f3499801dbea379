#include "client/rules/TRulesDocument.h"

#include <algorithm>
#include <cstring>

#include "client/files/TInputFile.h"
#include "host/TXmlParser.h"

namespace NORVZEL20 {

namespace {

const std::size_t kBlockSize = 64 * 1024;

// By hand, because a stream hides a lack of memory.
std::vector<std::string> SplitAtBlanks(const std::string& text)
{
    const char blanks[] = " \t\n\v\f\r";
    std::vector<std::string> words;
    std::size_t begin = text.find_first_not_of(blanks);
    while (begin != std::string::npos) {
        const std::size_t end = std::min(text.find_first_of(blanks, begin), text.size());
        words.push_back(text.substr(begin, end - begin));
        begin = text.find_first_not_of(blanks, end);
    }
    return words;
}

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
        element.excludedKeys = SplitAtBlanks(attrs["excludekeys"]);
        element.line = GetCurLine();
        fElements.push_back(element);
    }

    std::vector<TRulesDocument::TElement>& fElements;
    TCIMDiffEngine::propType fTreatment = TCIMDiffEngine::EXCLUDE;
    std::string fText;
};

std::string ReadWhole(const std::string& path)
{
    TInputFile file(path == "-" ? "./-" : path);  // rules never come from standard input
    std::string text;
    std::vector<char> block(kBlockSize);
    while (const std::size_t count = file.Read(block.data(), block.size())) {
        text.append(block.data(), count);
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
