#include "client/rules/TRulesFault.h"

#include "client/text/DisplayText.h"
#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

const std::size_t kLongest = 80;

// Text from the rules, shortened.
std::string Shorten(const std::string& text)
{
    return std::string(TUtf8::Shorten(text, kLongest)) + (text.size() > kLongest ? "..." : "");
}

std::string Quote(const std::string& text)
{
    return '"' + Shorten(text) + '"';
}

// A name; in quotes if a reader could not see where it ends.
std::string Show(const std::string& name)
{
    return name.find_first_of(" \t\r\n\"") == std::string::npos ? Shorten(name) : Quote(name);
}

}  // namespace

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
        return "element " + Show(text) +
               " is not expected here; a file is DifftoolSpec > class > includelist or excludelist > value";
    case kUnknownRootAttribute:
        return "element DifftoolSpec has an unknown attribute " + Show(text) + "; its only attribute is version, at most \"1.0\"";
    case kUnknownVersion:
        return "version " + Quote(text) + " of DifftoolSpec is unknown; use \"1.0\"";
    case kUnknownClassAttribute:
        return "element class has an unknown attribute " + Show(text) + "; its attributes are name, default and excludekeys";
    case kInvalidDefault:
        return "default " + Quote(text) + " is neither \"include\" nor \"exclude\"; letter case counts";
    case kNoClassName:
        return "element class has no name; give it the name of a class of the reference";
    case kUnknownClass:
        return "class " + Show(className) + " is not declared in the reference; correct the name or remove the element";
    case kUnknownProperty:
        return "class " + Show(className) + " has no property " + Quote(text) +
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
