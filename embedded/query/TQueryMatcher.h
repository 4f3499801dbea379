#pragma once

#include <cstdint>
#include <vector>

#include "embedded/query/TQueryCondition.h"
#include "embedded/store/TInMemClass.h"

namespace NORVZEL20 {

/// A condition bound to one class: knows the slots of the properties and has checked that their types allow the tests.
class TQueryMatcher {
  public:
    /// A property that `cls` does not declare counts as NULL (a subclass may have it; see TQuery). Both must outlive the matcher.
    /// Errors: TQueryError with status 16 for a test that a type does not allow.
    TQueryMatcher(const TQueryCondition& condition, const TInMemClass& cls);

    /// Whether the condition is true for an instance of the class.
    bool Matches(const TInMemInstance& instance) const { return Evaluate(fCondition, instance) == kTrue; }

  private:
    /// The order makes OR the greatest and AND the least of its parts.
    enum ETruth { kFalse, kUnknown, kTrue };

    void Bind(const TQueryCondition& condition);
    void CheckComparison(const TQueryCondition& test) const;
    void CheckText(const TQueryCondition& test) const;
    void CheckIsA(const TQueryCondition& test) const;
    TCIMValue::TCIMType GetType(const TQueryOperand& operand) const;
    ETruth Evaluate(const TQueryCondition& condition, const TInMemInstance& instance) const;
    ETruth EvaluateParts(const TQueryCondition& condition, const TInMemInstance& instance) const;
    ETruth EvaluateComparison(const TQueryCondition& test, const TInMemInstance& instance) const;
    ETruth EvaluateLike(const TQueryCondition& test, const TInMemInstance& instance) const;
    ETruth EvaluateIsA(const TQueryCondition& test, const TInMemInstance& instance) const;
    bool IsA(std::string_view className, std::string_view wanted) const;
    const TCIMValue& GetValue(const TQueryOperand& operand, const TInMemInstance& instance) const;

    const TQueryCondition& fCondition;
    const TInMemClass& fClass;
    std::vector<std::uint32_t> fSlots;  // by ordinal of the property in the condition
};

}  // namespace NORVZEL20
