#pragma once

#include <cstdint>
#include <vector>

#include "embedded/query/TQueryCondition.h"
#include "embedded/store/TInMemClass.h"

namespace NORVZEL20 {

/// A condition bound to one class: it has the slots of the properties, and their types allow the tests.
class TQueryMatcher {
  public:
    /// Both must outlive the matcher. A property that `cls` does not declare counts as NULL, because another class of the query may
    /// declare it.
    /// Errors: TQueryError with kInvalidQuery (16) for a test that a type does not allow.
    TQueryMatcher(const TQueryCondition& condition, const TInMemClass& cls);

    /// Whether the condition is true for an instance of the class.
    bool Matches(const TInMemInstance& instance) const { return Evaluate(fCondition, instance) == kTrue; }

  private:
    /// In this order OR is the greatest of its parts, AND the least of its parts, and NOT x is kTrue - x.
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
