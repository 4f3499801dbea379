// A query is parsed once, and then run in three steps:
//
//  1. Find the class and its subclasses, and check that each property of the query is declared in one of them.
//  2. Bind the condition to each class. This finds the slots of the properties and checks that their types allow the tests.
//  3. Visit the instances class by class and call back for those that the condition is true for.
//
// All errors are reported in the first two steps, before the first callback.

#include "embedded/query/TQuery.h"

#include <algorithm>

#include "embedded/query/TQueryCondition.h"
#include "embedded/query/TQueryError.h"
#include "embedded/query/TQueryMatcher.h"
#include "embedded/query/TQueryParser.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

using TClasses = std::vector<boost::shared_ptr<TInMemClass>>;

/// A property of a subclass is enough: instances of other classes have a NULL in its place.
void RequireProperty(const TClasses& classes, const std::string& name, std::size_t position)
{
    const bool isDeclared = std::any_of(classes.begin(), classes.end(), [&name](const boost::shared_ptr<TInMemClass>& cls) {
        return cls->GetLayout().FindSlot(name) != TInMemLayout::kNoSlot;
    });
    if (!isDeclared) {
        throw TQueryError(TZELStatusCode::kNotFound, "class '" + classes[0]->GetName() + "' has no property '" + name + "'",
                          position);
    }
}

void RequireProperties(const TClasses& classes, const TQueryCondition& condition)
{
    for (const auto& part : condition.parts) {
        RequireProperties(classes, *part);
    }
    for (const TQueryOperand& operand : condition.operands) {
        if (!operand.name.empty()) {
            RequireProperty(classes, operand.name, operand.position);
        }
    }
}

}  // namespace

TQuery::TQuery(const std::string& language, const std::string& text)
{
    if (!TNameText::Equal(language, "WQL") && !TNameText::Equal(language, "DMTF:CQL")) {
        throw TQueryError(TZELStatusCode::kQueryLanguageUnknown,
                          "the language '" + language + "' is not known here; use WQL or DMTF:CQL", 0);
    }
    TQueryParser(text, *this).Parse();
}

TQuery::~TQuery() = default;

void TQuery::Execute(TInMemNamespace& ns, const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback) const
{
    const auto keep = ns.shared_from_this();  // the callback may release the last use of the namespace
    TClasses classes{ns.FindClass(fClassName)};
    if (!classes[0]) {
        throw TQueryError(TZELStatusCode::kNotFound, "there is no class '" + fClassName + "'", fClassPosition);
    }
    const TClasses below = classes[0]->GetClassesBelow();
    classes.insert(classes.end(), below.begin(), below.end());
    for (std::size_t at = 0; at < fProperties.size(); ++at) {
        RequireProperty(classes, fProperties[at], fPropertyPositions[at]);
    }
    std::vector<TQueryMatcher> matchers;
    if (fCondition) {
        RequireProperties(classes, *fCondition);
        for (const auto& cls : classes) {
            matchers.emplace_back(*fCondition, *cls);
        }
    }
    for (std::size_t at = 0; at < classes.size(); ++at) {
        bool goesOn = true;
        classes[at]->EnumerateInstances(
            [&](boost::shared_ptr<ICIMInstance> instance) {
                const bool isWanted = !fCondition || matchers[at].Matches(static_cast<const TInMemInstance&>(*instance));
                goesOn = !isWanted || callback(instance);
                return goesOn;
            },
            false, TCallContext());
        if (!goesOn) {
            return;
        }
    }
}

}  // namespace NORVZEL20
