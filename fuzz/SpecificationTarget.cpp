// Reads a text as a specification file, twice, against the schema of the sample.
//
// An accepted file must give rules for classes of the schema and log nothing. A refused file must throw kParseError (9) and log the
// reason with its line. Both readings must give the same rules.

#include "fuzz/Promise.h"
#include "fuzz/SampleInventory.h"
#include "fuzz/TFuzzTarget.h"
#include "fuzz/TLogRecorder.h"
#include "spec/TDiffClassRules.h"
#include "spec/TDiffXMLParser.h"

namespace NORVZEL20 {

namespace {

struct TReadOutcome {
    std::string rules;  ///< empty if the text was refused
    std::vector<std::string> log;
    int status = 0;
};

void CheckRules(ICIMNamespace& schema, const std::string& className, TCIMDiffEngine::TDiffClassRules& rules)
{
    Promise(schema.GetClass(className, TCallContext())->GetName(TCallContext()).size() == className.size(),
            "rules are for classes of the schema");
    Promise(rules.fDefault == TCIMDiffEngine::INCLUDE || rules.fDefault == TCIMDiffEngine::EXCLUDE,
            "a default is include or exclude");
    for (const std::string& key : rules.fExcludedKeys) {
        Promise(!key.empty() && key.find_first_of(" \t\r\n\v\f") == std::string::npos, "keys are separated by blanks");
        Promise(rules.isKeyExcluded(key) && rules.hasExcludedKeys(), "an excluded key is known as one");
    }
}

std::string Describe(ICIMNamespace& schema, TCIMDiffEngine::TRuleset ruleset)
{
    std::string text = "rules\n";
    for (const auto& [className, rules] : ruleset.fRules) {
        CheckRules(schema, className, *rules);
        text += className + " " + TCIMDiffEngine::strPropType(rules->fDefault) + "\n";
        for (const auto& [property, treatment] : rules->fProperties) {
            text += "  " + property + " " + TCIMDiffEngine::strPropType(treatment) + "\n";
        }
        for (const std::string& key : rules->fExcludedKeys) {
            text += "  without " + key + "\n";
        }
    }
    return text;
}

TReadOutcome Read(const boost::shared_ptr<ICIMNamespace>& schema, std::string text)
{
    TReadOutcome outcome;
    TLogRecorder log;
    try {
        TCIMDiffEngine::TDiffXMLParser parser(schema);
        parser.Parse(text.data(), text.size());
        outcome.rules = Describe(*schema, parser.getRuleset());
    } catch (const TZELException& error) {
        outcome.status = error.GetStatusCode().GetStatus();
    }
    outcome.log = log.GetMessages();
    return outcome;
}

bool StartsWith(const std::string& text, const std::string& start)
{
    return text.compare(0, start.size(), start) == 0;
}

/// An error in a tag is logged twice, an error of the document once.
void CheckRefusal(const TReadOutcome& outcome)
{
    Promise(outcome.status == TZELStatusCode::kParseError, "a refused text has the status kParseError (9)");
    Promise(outcome.log.size() == 1 || outcome.log.size() == 2, "a refusal is logged once or twice");
    Promise(StartsWith(outcome.log[0], "Diff-XML Parser line "), "the first entry has the line", outcome.log[0]);
    Promise(outcome.log.size() == 1 || StartsWith(outcome.log[1], "TDiffXMLParser: Thr"), "the second entry names the kind of tag",
            outcome.log.back());
}

}  // namespace

void FuzzSpecification(std::string_view input)
{
    static const boost::shared_ptr<ICIMNamespace> fgSchema = LoadSample();
    const TReadOutcome outcome = Read(fgSchema, std::string(input));
    if (outcome.rules.empty()) {
        CheckRefusal(outcome);
    } else {
        Promise(outcome.log.empty(), "an accepted text logs nothing");
    }
    PromiseEqual(outcome.rules, Read(fgSchema, std::string(input)).rules, "the same text gives the same rules");
}

}  // namespace NORVZEL20
