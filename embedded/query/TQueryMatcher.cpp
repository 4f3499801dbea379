// Evaluates a condition for an instance, in three-valued logic: true, unknown and false.
//
// A test is unknown if a value does not say enough (see TQueryComparison). OR is as true as its truest part, AND as its least true
// part, and NOT swaps true and false and leaves unknown. An instance is part of the answer only if the whole condition is true. So
// `Size = 5` and `NOT Size = 5` both leave out an instance whose Size is NULL.
//
// Everything that depends on the class alone is done once, when the matcher is made: finding the slots of the properties, and
// refusing tests that the types of the properties do not allow.

#include "embedded/query/TQueryMatcher.h"

#include <algorithm>

#include "embedded/query/TQueryComparison.h"
#include "embedded/query/TQueryError.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TValueText.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

namespace {

using TType = TCIMValue::TCIMType;

/// An operand and its type for a message, such as "'Size' (uint64)".
std::string Describe(const TQueryOperand& operand, TType type)
{
    const std::string name = operand.name.empty() ? "the value" : "'" + operand.name + "'";
    return name + " (" + TValueText::GetTypeName(type) + (type.IsArray() ? " array)" : ")");
}

[[noreturn]] void Refuse(const std::string& message, std::size_t position)
{
    throw TQueryError(TZELStatusCode::kInvalidQuery, message, position);
}

}  // namespace

TQueryMatcher::TQueryMatcher(const TQueryCondition& condition, const TInMemClass& cls) : fCondition(condition), fClass(cls)
{
    Bind(condition);
}

void TQueryMatcher::Bind(const TQueryCondition& condition)
{
    for (const auto& part : condition.parts) {
        Bind(*part);
    }
    for (const TQueryOperand& operand : condition.operands) {
        if (!operand.name.empty()) {
            // A property that this class does not declare keeps kNoSlot and counts as NULL.
            fSlots.resize(std::max(fSlots.size(), operand.ordinal + 1), TInMemLayout::kNoSlot);
            fSlots[operand.ordinal] = fClass.GetLayout().FindSlot(operand.name);
        }
    }
    if (condition.kind == TQueryCondition::kLike) {
        CheckText(condition);
    } else if (condition.kind == TQueryCondition::kIsA) {
        CheckIsA(condition);
    } else if (condition.operands.size() == 2) {
        CheckComparison(condition);
    }
}

TType TQueryMatcher::GetType(const TQueryOperand& operand) const
{
    if (operand.name.empty()) {
        return operand.literal.GetType();
    }
    const std::uint32_t slot = fSlots[operand.ordinal];
    return slot == TInMemLayout::kNoSlot ? TType(TType::kNone) : fClass.GetLayout().GetDecl(slot).GetType();
}

void TQueryMatcher::CheckComparison(const TQueryCondition& test) const
{
    const TQueryOperand& left = test.operands[0];
    const TQueryOperand& right = test.operands[1];
    const TType leftType = GetType(left);
    const TType rightType = GetType(right);
    const bool isOrder = test.kind != TQueryCondition::kEqual && test.kind != TQueryCondition::kNotEqual;
    if (!TQueryComparison::AreComparable(leftType, rightType)) {
        Refuse(Describe(left, leftType) + " and " + Describe(right, rightType) + " do not compare", test.position);
    }
    if (isOrder && !TQueryComparison::AreOrdered(leftType, rightType)) {
        Refuse(Describe(left, leftType) + " and " + Describe(right, rightType) + " have no order", test.position);
    }
    // A text that is compared with a datetime must be one. Found here, it is an error; found later, it would be unknown.
    for (const auto& [literal, type] : {std::make_pair(&left, rightType), std::make_pair(&right, leftType)}) {
        if (literal->name.empty() && !TQueryComparison::IsReadable(literal->literal, type)) {
            Refuse("'" + literal->literal.ToText() + "' is no datetime", literal->position);
        }
    }
}

void TQueryMatcher::CheckText(const TQueryCondition& test) const
{
    const TType type = GetType(test.operands[0]);
    if (type != TType::kString && type != TType::kNone) {
        Refuse("LIKE needs text, " + Describe(test.operands[0], type) + " is none", test.position);
    }
}

void TQueryMatcher::CheckIsA(const TQueryCondition& test) const
{
    const TType type = GetType(test.operands[0]);
    if (!test.operands[0].isClass && type != TType::kString && type != TType::kReference && type != TType::kNone) {
        Refuse("ISA needs an embedded object or a reference, " + Describe(test.operands[0], type) + " is none", test.position);
    }
}

const TCIMValue& TQueryMatcher::GetValue(const TQueryOperand& operand, const TInMemInstance& instance) const
{
    if (operand.name.empty()) {
        return operand.literal;
    }
    // Stands for a property that another class of the query declares.
    static const TCIMValue fgNull;
    const std::uint32_t slot = fSlots[operand.ordinal];
    return slot == TInMemLayout::kNoSlot ? fgNull : instance.GetSlotValue(slot);
}

TQueryMatcher::ETruth TQueryMatcher::Evaluate(const TQueryCondition& condition, const TInMemInstance& instance) const
{
    switch (condition.kind) {
    case TQueryCondition::kOr:
    case TQueryCondition::kAnd:
        return EvaluateParts(condition, instance);
    case TQueryCondition::kNot:
        return static_cast<ETruth>(kTrue - Evaluate(*condition.parts[0], instance));
    case TQueryCondition::kIsNull:
        return GetValue(condition.operands[0], instance).IsNull() ? kTrue : kFalse;
    case TQueryCondition::kLike:
        return EvaluateLike(condition, instance);
    case TQueryCondition::kIsA:
        return EvaluateIsA(condition, instance);
    default:
        return EvaluateComparison(condition, instance);
    }
}

TQueryMatcher::ETruth TQueryMatcher::EvaluateParts(const TQueryCondition& condition, const TInMemInstance& instance) const
{
    const bool isOr = condition.kind == TQueryCondition::kOr;
    const ETruth decisive = isOr ? kTrue : kFalse;
    ETruth result = isOr ? kFalse : kTrue;
    for (const auto& part : condition.parts) {
        const ETruth truth = Evaluate(*part, instance);
        // One part settles the result; the others are not evaluated.
        if (truth == decisive) {
            return decisive;
        }
        result = truth == kUnknown ? kUnknown : result;
    }
    return result;
}

TQueryMatcher::ETruth TQueryMatcher::EvaluateComparison(const TQueryCondition& test, const TInMemInstance& instance) const
{
    const auto result = TQueryComparison::Compare(GetValue(test.operands[0], instance), GetValue(test.operands[1], instance));
    const auto isOne = [result](TQueryComparison::EResult a, TQueryComparison::EResult b) { return result == a || result == b; };
    if (result == TQueryComparison::kUnknown) {
        return kUnknown;
    }
    switch (test.kind) {
    case TQueryCondition::kEqual:
        return result == TQueryComparison::kEqual ? kTrue : kFalse;
    case TQueryCondition::kNotEqual:
        return result != TQueryComparison::kEqual ? kTrue : kFalse;
    case TQueryCondition::kLess:
        return result == TQueryComparison::kLess ? kTrue : kFalse;
    case TQueryCondition::kLessOrEqual:
        return isOne(TQueryComparison::kLess, TQueryComparison::kEqual) ? kTrue : kFalse;
    case TQueryCondition::kGreater:
        return result == TQueryComparison::kGreater ? kTrue : kFalse;
    default:
        return isOne(TQueryComparison::kGreater, TQueryComparison::kEqual) ? kTrue : kFalse;
    }
}

TQueryMatcher::ETruth TQueryMatcher::EvaluateLike(const TQueryCondition& test, const TInMemInstance& instance) const
{
    const TCIMValue& value = GetValue(test.operands[0], instance);
    if (value.IsNull() || value.GetEmbeddedObject()) {
        return kUnknown;
    }
    return test.pattern->Matches(value.GetString()) ? kTrue : kFalse;
}

TQueryMatcher::ETruth TQueryMatcher::EvaluateIsA(const TQueryCondition& test, const TInMemInstance& instance) const
{
    if (test.operands[0].isClass) {
        return fClass.IsSubclassOf(test.className) ? kTrue : kFalse;
    }
    const TCIMValue& value = GetValue(test.operands[0], instance);
    if (value.IsNull()) {
        return kUnknown;
    }
    if (value.GetType() == TType::kReference) {
        const TCIMReference path = value;
        return IsA(path.GetClassName(), test.className) ? kTrue : kFalse;
    }
    // Plain text is of no class.
    const auto object = value.GetEmbeddedObject();
    return object && IsA(object->GetClassName(), test.className) ? kTrue : kFalse;
}

/// Whether the class of that name is the wanted one or below it. A class that is not declared has only its name.
bool TQueryMatcher::IsA(std::string_view className, std::string_view wanted) const
{
    const auto ns = fClass.GetInMemNamespace();
    const auto cls = ns ? ns->FindClass(className) : nullptr;
    return cls ? cls->IsSubclassOf(wanted) : TNameText::Equal(className, wanted);
}

}  // namespace NORVZEL20
