#include "client/rules/TRulesFault.h"

#include "client/rules/ShowText.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

std::string TRulesFault::Describe(const std::string& file) const
{
    if (kind == kSchemaFailed) {
        return file + ": cannot be used as rules: " + text;
    }
    return file + ":" + std::to_string(line) + ": " + EscapeForDisplay(DescribeWithoutPlace());
}

std::string TRulesFault::DescribeWithoutPlace() const
{
    switch (kind) {
    case kUnexpectedElement:
        return "element " + ShowName(text) +
               " is not expected here; a file is DifftoolSpec > class > includelist or excludelist > value";
    case kUnknownRootAttribute:
        return "element DifftoolSpec has an unknown attribute " + ShowName(text) +
               "; its only attribute is version, at most \"1.0\"";
    case kUnknownVersion:
        return "version " + QuoteText(text) + " of DifftoolSpec is unknown; use \"1.0\"";
    case kUnknownClassAttribute:
        return "element class has an unknown attribute " + ShowName(text) + "; its attributes are name, default and excludekeys";
    case kInvalidDefault:
        return "default " + QuoteText(text) + " is neither \"include\" nor \"exclude\"; letter case counts";
    case kNoClassName:
        return "element class has no name; give it the name of a class of the reference";
    case kUnknownClass:
        return "class " + ShowName(className) + " is not declared in the reference; correct the name or remove the element";
    case kUnknownProperty:
        return "class " + ShowName(className) + " has no property " + QuoteText(text) +
               "; the name counts as it stands between the tags, blanks included";
    case kWrongEncoding:
        return "the text cannot be decoded (" + text + "); save the file as UTF-8";
    case kMalformed:
    case kSchemaFailed:
        break;
    }
    return text + "; correct the file";
}

}  // namespace NORVZEL20
