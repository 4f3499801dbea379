// A report without rules gets a whole file: the rule for everything, and an element for the class. If there are rules, what must be
// changed depends on the element that decides now:
//
//   no element is for the class         a new element at the end, which is merged into what the class inherits
//   the property is in a list           its line is moved to an excludelist of the same element
//   an element of the class decides     that element gets an excludelist
//   an element of another class decides although the class has one: a new element at the end if the plug-in then leaves the
//                                       property out; otherwise the element that decides gets an excludelist
#include "client/report/html/TRuleProposals.h"

#include <algorithm>

#include "client/rules/RulesXml.h"
#include "client/text/QuoteForShell.h"
#include "host/RootClassName.h"

namespace NORVZEL20 {

namespace {

std::string ElementWith(const std::string& className, TCIMDiffEngine::propType treatment, const std::vector<std::string>& excluded)
{
    return WriteRulesElement({className, treatment == TCIMDiffEngine::INCLUDE ? "include" : "exclude", {}, {}, excluded});
}

std::string WholeFile(const std::string& element)
{
    return WriteRulesDocument(ElementWith(kRootClassName, TCIMDiffEngine::INCLUDE, {}) + element);
}

std::string Line(unsigned line)
{
    return "line " + std::to_string(line);
}

}  // namespace

TRuleProposals::TRuleProposals(const TComparisonReport& report)
    : fReport(report), fText({report.rules, report.rulesText, report.areRulesMade}),
      // The majority has no schema of its own.
      fSchema((report.run ? *report.run : report).inventories->front().ns)
{
    if (!report.areRulesMade) {
        const boost::shared_ptr<ICIMNamespace> schema = fSchema;
        fRules = std::make_unique<TRules>(schema, fText);
        fTrace = std::make_unique<TRuleTrace>(fRules->GetDocument(), schema);
    }
}

const TRuleProposals::TProposal& TRuleProposals::LeaveOutProperty(const std::string& className, const std::string& path)
{
    const std::pair<std::string, std::string> key(className, path.substr(0, path.find('.')));
    const auto known = fForProperties.find(key);
    return known != fForProperties.end() ? known->second
                                         : fForProperties.emplace(key, ForProperty(key.first, key.second)).first->second;
}

const TRuleProposals::TProposal& TRuleProposals::LeaveOutClass(const std::string& className)
{
    const auto known = fForClasses.find(className);
    return known != fForClasses.end() ? known->second : fForClasses.emplace(className, ForClass(className)).first->second;
}

TRuleProposals::TProposal TRuleProposals::ForProperty(const std::string& className, const std::string& property)
{
    const std::string what = "Leaves " + property + " of " + className + " out, and of the classes below it; so does --exclude " +
                             QuoteForShell(className + "." + property) + ".";
    if (!fTrace) {
        return {what, "It is a whole file: compare with --spec FILE.",
                WholeFile(ElementWith(className, TCIMDiffEngine::INCLUDE, {property}))};
    }
    const TRuleTrace::TDecision decision = fTrace->Decide(className, property);
    const std::string added = ElementWith(className, fTrace->Find(className).byDefault.treatment, {property});
    const bool hasOwn = !ElementsOf(className).empty();
    if (!hasOwn || (decision.fromClass != className && WouldLeaveOut(className, property, added))) {
        return {what, AtEnd(), added};
    }
    const std::string list = WriteRulesList("excludelist", {property});
    const std::string of = decision.fromClass == className
                               ? what
                               : "Leaves " + property + " of " + decision.fromClass + " out, and of the classes below it.";
    if (decision.isListed) {
        return {of,
                "In " + fReport.rules + ", take " + property + " out of the list at " + Line(decision.line) +
                    ", and put this list into the same element.",
                list};
    }
    return {of,
            "In " + fReport.rules + ", put this list into the element of " + decision.fromClass + " at " + Line(decision.line) +
                ".",
            list};
}

TRuleProposals::TProposal TRuleProposals::ForClass(const std::string& className)
{
    const std::string what =
        "Rules cannot leave out single instances; this leaves out all of " + className + ", and of the classes below it.";
    if (!fTrace) {
        return {what, "It is a whole file: compare with --spec FILE.",
                WholeFile(ElementWith(className, TCIMDiffEngine::EXCLUDE, {}))};
    }
    const TElements own = ElementsOf(className);
    if (!own.empty()) {
        std::string lines;
        for (const TRulesDocument::TElement* const element : own) {
            lines += (lines.empty() ? "" : " and ") + Line(element->line);
        }
        return {what, "In " + fReport.rules + ", this takes the place of the element of " + className + " at " + lines + ".",
                ElementWith(className, TCIMDiffEngine::EXCLUDE, {})};
    }
    // Listings that the class inherits stay, so they are turned round.
    std::vector<std::string> included;
    for (const auto& [property, decision] : fTrace->Find(className).listed) {
        if (decision.treatment == TCIMDiffEngine::INCLUDE) {
            included.push_back(property);
        }
    }
    return {what, AtEnd(), ElementWith(className, TCIMDiffEngine::EXCLUDE, included)};
}

TRuleProposals::TElements TRuleProposals::ElementsOf(const std::string& className) const
{
    TElements elements;
    for (const TRulesDocument::TElement& element : fRules->GetDocument().elements) {
        if (element.className == className) {
            elements.push_back(&element);
        }
    }
    return elements;
}

// Asks the plug-in.
bool TRuleProposals::WouldLeaveOut(const std::string& className, const std::string& property, const std::string& element) const
{
    const std::size_t end = fText.text.rfind(kRulesDocumentEnd);
    if (end == std::string::npos) {
        return false;
    }
    TRulesText changed = fText;
    changed.text.insert(end, element);
    const std::vector<std::string> compared = TRules(fSchema, changed).PropertiesOf(fSchema->FindClass(className));
    return std::find(compared.begin(), compared.end(), property) == compared.end();
}

std::string TRuleProposals::AtEnd() const
{
    return "In " + fReport.rules + ", put this element at the end, in front of " + kRulesDocumentEnd + ".";
}

}  // namespace NORVZEL20
