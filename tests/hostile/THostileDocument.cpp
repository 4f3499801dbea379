#include "tests/hostile/THostileDocument.h"

#include <map>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "fuzz/SampleInventory.h"
#include "fuzz/TLogRecorder.h"
#include "host/TXmlParser.h"
#include "spec/TDiffClassRules.h"
#include "spec/TDiffXMLParser.h"
#include "tests/hostile/TMemoryMeter.h"

namespace NORVZEL20 {

namespace {

/// Counts elements and keeps the text; notes the reason of a failure, and a second one as an error.
class TPlainParser : public TXmlParser {
  public:
    void StartElement(const char*, std::map<std::string, std::string>&) override { ++fElements; }
    void characters(const char* text, unsigned int length) override { fText.append(text, length); }
    void FatalError(const char* message) override
    {
        if (!fReason.empty()) {
            fReason += " AND AGAIN ";
        }
        fReason += "line " + std::to_string(GetCurLine()) + ": " + message;
    }
    std::string Describe() const
    {
        return fReason.empty() ? std::to_string(fElements) + " elements, text '" + fText + "'" : fReason;
    }

  private:
    std::size_t fElements = 0;
    std::string fText;
    std::string fReason;
};

std::string DescribeRules(TCIMDiffEngine::TRuleset ruleset)
{
    std::string outcome = "rules for";
    for (const auto& property : ruleset.getClassRules("Device")->fProperties) {
        outcome += " '" + property.first + "'";
    }
    return outcome;
}

std::string DescribeRefusal(const TZELException& error, const TLogRecorder& log)
{
    std::string outcome = "status " + std::to_string(error.GetStatusCode().GetStatus());
    for (const std::string& message : log.GetMessages()) {
        outcome += "\n" + message;
    }
    return outcome;
}

template <class TRead>
TReading Measure(TRead read)
{
    const TMemoryMeter meter;
    const std::string outcome = read();
    return {outcome, meter.GetPeak(), meter.GetTotal()};
}

}  // namespace

std::string THostileDocument::Encoded(const std::string& beginning, const std::string& end) const
{
    const std::string whole = prolog + beginning + content + end;
    return encode == nullptr ? whole : encode(whole);
}

TReading THostileDocument::ReadByParser() const
{
    std::string text = Encoded("<r>", "</r>");
    return Measure([&text] {
        TPlainParser parser;
        parser.Parse(text.data(), text.size());
        return parser.Describe();
    });
}

TReading THostileDocument::LoadByPopulator() const
{
    const std::string text = Encoded("<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP><VALUE.OBJECT>"
                                     "<INSTANCE CLASSNAME=\"Device\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><VALUE>",
                                     "</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT></DECLGROUP></DECLARATION></CIM>");
    const boost::shared_ptr<TInMemNamespace> ns = LoadSample();
    return Measure([&text, &ns]() -> std::string {
        TCimXmlPopulator populator(ns);
        populator.KeepElements();
        try {
            populator.LoadFromMemory(text.data(), text.size(), "hostile.xml");
        } catch (const TPopulateError& error) {
            return error.what();
        }
        const auto instance = boost::dynamic_pointer_cast<ICIMInstance>(populator.TakeElements().at(0));
        return "loaded '" + instance->GetProperty("Id", TCallContext())->GetValue(TCallContext()).ToText() + "'";
    });
}

TReading THostileDocument::ReadAsSpecification() const
{
    std::string text =
        Encoded("<DifftoolSpec><class name=\"Device\"><includelist><value>", "</value></includelist></class></DifftoolSpec>");
    const boost::shared_ptr<ICIMNamespace> schema = LoadSample();
    return Measure([&text, &schema] {
        TLogRecorder log;
        try {
            TCIMDiffEngine::TDiffXMLParser parser(schema);
            parser.Parse(text.data(), text.size());
            return DescribeRules(parser.getRuleset());
        } catch (const TZELException& error) {
            return DescribeRefusal(error, log);
        }
    });
}

}  // namespace NORVZEL20
