// To learn which element decides what, this file lets the plug-in's own merge run over marks in place of rules.
//
// The merge copies, overwrites and hands down the treatments of properties by their names. What the names and the treatments are
// makes no difference to it. So a mark is the position of an element in binary, spelled by made-up properties: one for each digit,
// with EXCLUDE for 1 and INCLUDE for 0. The element at position 5 that lists Size becomes rules that list
//
//     the mark of Size:           "Size" \1 "0" = 1     "Size" \1 "1" = 0     "Size" \1 "2" = 1
//     the mark of the default:    ""     \1 "0" = 1     ""     \1 "1" = 0     ""     \1 "2" = 1
//
// Every mark has the same number of digits, so a mark replaces an earlier one as a whole. After the merge, the marks of a
// class are the positions of the elements that decide there. Excluded keys are only ever copied together; the position takes their
// place as one text. Made-up names cannot meet real ones, because the character \1 cannot occur in XML.
#include "client/rules/TRuleMarks.h"

#include <boost/smart_ptr/make_shared.hpp>
#include <utility>

namespace NORVZEL20 {

namespace {

const char kSeparator = '\x01';

const char kDefault[] = "";

std::string DigitName(const std::string& property, std::size_t digit)
{
    return property + kSeparator + std::to_string(digit);
}

}  // namespace

TRuleMarks::TRuleMarks(const std::vector<TRulesDocument::TElement>& elements, boost::shared_ptr<ICIMNamespace> schema)
    : fElements(elements), fSchema(std::move(schema))
{
    while ((elements.size() >> fDigits) != 0) {
        ++fDigits;
    }
}

void TRuleMarks::Merge(std::size_t element)
{
    std::map<std::string, TCIMDiffEngine::propType> marks;
    Write(marks, kDefault, element);
    for (const TRulesDocument::TListed& listed : fElements[element].listed) {
        Write(marks, listed.property, element);
    }
    const std::vector<std::string> keys(1, std::to_string(element));
    const std::string& className = fElements[element].className;
    fMarks.addToRuleset(className, boost::make_shared<TMarks>(TCIMDiffEngine::EXCLUDE, marks, keys), true);
    fMarks.updateRuleset(className, std::string(), fSchema);
}

bool TRuleMarks::IsFinal(const std::string& className) const
{
    const TMarks* const marks = Find(className);
    return marks != nullptr && marks->fFinal;
}

std::optional<std::size_t> TRuleMarks::FindDefault(const std::string& className) const
{
    const TMarks* const marks = Find(className);
    return marks == nullptr ? std::nullopt : std::make_optional(Read(*marks, kDefault));
}

std::optional<std::size_t> TRuleMarks::FindKeys(const std::string& className) const
{
    const TMarks* const marks = Find(className);
    return marks == nullptr ? std::nullopt : std::make_optional<std::size_t>(std::stoul(marks->fExcludedKeys.front()));
}

std::map<std::string, std::size_t> TRuleMarks::FindListed(const std::string& className) const
{
    std::map<std::string, std::size_t> elements;
    if (const TMarks* const marks = Find(className)) {
        for (const auto& digit : marks->fProperties) {
            const std::string property = digit.first.substr(0, digit.first.find(kSeparator));
            if (property != kDefault && elements.count(property) == 0) {
                elements[property] = Read(*marks, property);
            }
        }
    }
    return elements;
}

const TRuleMarks::TMarks* TRuleMarks::Find(const std::string& className) const
{
    const auto found = fMarks.fRules.find(className);
    return found == fMarks.fRules.end() ? nullptr : found->second.get();
}

void TRuleMarks::Write(std::map<std::string, TCIMDiffEngine::propType>& marks, const std::string& property,
                       std::size_t number) const
{
    for (std::size_t digit = 0; digit < fDigits; ++digit) {
        marks[DigitName(property, digit)] = (number >> digit & 1) != 0 ? TCIMDiffEngine::EXCLUDE : TCIMDiffEngine::INCLUDE;
    }
}

std::size_t TRuleMarks::Read(const TMarks& marks, const std::string& property) const
{
    std::size_t number = 0;
    for (std::size_t digit = 0; digit < fDigits; ++digit) {
        const std::size_t value = marks.fProperties.at(DigitName(property, digit)) == TCIMDiffEngine::EXCLUDE ? 1 : 0;
        number |= value << digit;
    }
    return number;
}

}  // namespace NORVZEL20
