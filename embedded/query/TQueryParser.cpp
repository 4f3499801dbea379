// A recursive-descent parser: each rule of the grammar in TQuery.h has an operation that reads what the rule describes and leaves
// the next token in fToken. TakeKeyword and TakeSymbol go on to the next token only if the present one is what they look for.
//
// AND binds more tightly than OR and NOT more tightly than AND, because ReadOr reads its parts with ReadAnd and that with ReadNot.
// IS NOT NULL becomes the NOT of an IS NULL. The listed properties are kept until the class is known, because they may have its
// name in front. Depth is bounded: each level of parentheses or NOT takes stack, here and when the condition is evaluated.

#include "embedded/query/TQueryParser.h"

#include <algorithm>
#include <iterator>
#include <utility>

#include "embedded/query/TQueryError.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

/// Key words are not names: `SELECT FROM Disk` lacks its list and must not take FROM for a property.
const char* const kKeywords[] = {"SELECT", "FROM", "WHERE", "AND", "OR", "NOT", "IS", "NULL", "LIKE", "ISA", "TRUE", "FALSE"};

bool IsAnyKeyword(const std::string& name)
{
    return std::any_of(std::begin(kKeywords), std::end(kKeywords),
                       [&name](const char* keyword) { return TNameText::Equal(name, keyword); });
}

const std::pair<const char*, TQueryCondition::EKind> kComparisons[] = {
    {"=", TQueryCondition::kEqual},          {"<>", TQueryCondition::kNotEqual},    {"!=", TQueryCondition::kNotEqual},
    {"<", TQueryCondition::kLess},           {"<=", TQueryCondition::kLessOrEqual}, {">", TQueryCondition::kGreater},
    {">=", TQueryCondition::kGreaterOrEqual}};

}  // namespace

/// From here on fToken is always the next token that no operation has read.
TQueryParser::TQueryParser(const std::string& text, TQuery& query) : fQuery(query), fLexer(text)
{
    Advance();
}

void TQueryParser::Fail(const std::string& message, std::size_t position) const
{
    throw TQueryError(TZELStatusCode::kInvalidQuery, message, position);
}

void TQueryParser::FailExpected(const std::string& expected) const
{
    const std::string found = fToken.kind == TQueryToken::kEnd ? "the end of the query" : "'" + fToken.text + "'";
    Fail("expected " + expected + ", found " + found, fToken.position);
}

bool TQueryParser::IsKeyword(const char* word) const
{
    return fToken.kind == TQueryToken::kName && TNameText::Equal(fToken.text, word);
}

bool TQueryParser::IsSymbol(const char* symbol) const
{
    return fToken.kind == TQueryToken::kSymbol && fToken.text == symbol;
}

bool TQueryParser::TakeKeyword(const char* word)
{
    const bool isThere = IsKeyword(word);
    if (isThere) {
        Advance();
    }
    return isThere;
}

bool TQueryParser::TakeSymbol(const char* symbol)
{
    const bool isThere = IsSymbol(symbol);
    if (isThere) {
        Advance();
    }
    return isThere;
}

std::string TQueryParser::TakeName(const char* expected)
{
    if (fToken.kind != TQueryToken::kName || IsAnyKeyword(fToken.text)) {
        FailExpected(expected);
    }
    std::string name = fToken.text;
    Advance();
    return name;
}

void TQueryParser::Parse()
{
    if (!TakeKeyword("SELECT")) {
        FailExpected("SELECT");
    }
    ReadList();
    if (!TakeKeyword("FROM")) {
        FailExpected("FROM");
    }
    fQuery.fClassPosition = fToken.position;
    fQuery.fClassName = TakeName("the name of a class");
    // The class is known now, so names of it in front of listed properties can be checked.
    TakeList();
    if (TakeKeyword("WHERE")) {
        fQuery.fCondition = ReadOr();
    }
    if (fToken.kind != TQueryToken::kEnd) {
        // The message names what could have followed here.
        FailExpected(fQuery.fCondition ? "AND, OR or the end of the query" : "WHERE or the end of the query");
    }
}

void TQueryParser::ReadList()
{
    do {
        fListed.push_back(ReadListed());
    } while (TakeSymbol(","));
}

TQueryParser::TListed TQueryParser::ReadListed()
{
    TListed listed{std::string(), std::string(), fToken.position};
    if (TakeSymbol("*")) {
        return listed;
    }
    listed.name = TakeName("* or the name of a property");
    if (TakeSymbol(".")) {
        // The name was that of the class.
        listed.qualifier.swap(listed.name);
        listed.name = TakeSymbol("*") ? std::string() : TakeName("* or the name of a property");
    }
    return listed;
}

/// Passes the list to the query, now that the class is known. A * among the names stands for all properties.
void TQueryParser::TakeList()
{
    bool isEverything = false;
    for (const TListed& listed : fListed) {
        if (!listed.qualifier.empty() && !TNameText::Equal(listed.qualifier, fQuery.fClassName)) {
            Fail("'" + listed.qualifier + "' is not the class of this query", listed.position);
        }
        isEverything = isEverything || listed.name.empty();
        fQuery.fProperties.push_back(listed.name);
        fQuery.fPropertyPositions.push_back(listed.position);
    }
    if (isEverything) {
        fQuery.fProperties.clear();
        fQuery.fPropertyPositions.clear();
    }
}

TQueryParser::TPointer TQueryParser::ReadOr()
{
    // A single part is kept in its list too; that evaluates to the same.
    auto condition = std::make_unique<TQueryCondition>(TQueryCondition::kOr, fToken.position);
    do {
        condition->parts.push_back(ReadAnd());
    } while (TakeKeyword("OR"));
    return condition;
}

TQueryParser::TPointer TQueryParser::ReadAnd()
{
    auto condition = std::make_unique<TQueryCondition>(TQueryCondition::kAnd, fToken.position);
    do {
        condition->parts.push_back(ReadNot());
    } while (TakeKeyword("AND"));
    return condition;
}

TQueryParser::TPointer TQueryParser::ReadNot()
{
    const std::size_t position = fToken.position;
    // An error ends the parse, so only success takes the depth back.
    if (++fDepth > kMaxDepth) {
        Fail("conditions stand in each other more than " + std::to_string(kMaxDepth) + " deep", position);
    }
    TPointer condition;
    if (TakeKeyword("NOT")) {
        condition = std::make_unique<TQueryCondition>(TQueryCondition::kNot, position);
        condition->parts.push_back(ReadNot());
    } else if (TakeSymbol("(")) {
        condition = ReadOr();
        if (!TakeSymbol(")")) {
            FailExpected("AND, OR or )");
        }
    } else {
        condition = ReadTest();
    }
    --fDepth;
    return condition;
}

TQueryParser::TPointer TQueryParser::ReadTest()
{
    TQueryOperand left = ReadOperand();
    // ISA comes first, because it alone may have the name of the class on its left.
    if (IsKeyword("ISA")) {
        return ReadIsA(std::move(left));
    }
    if (left.isClass) {
        FailExpected("ISA behind the name of the class");
    }
    if (TakeKeyword("LIKE")) {
        return ReadLike(std::move(left));
    }
    if (TakeKeyword("IS")) {
        return ReadIsNull(std::move(left));
    }
    return ReadComparison(std::move(left));
}

TQueryParser::TPointer TQueryParser::ReadComparison(TQueryOperand left)
{
    for (const auto& [symbol, kind] : kComparisons) {
        if (!IsSymbol(symbol)) {
            continue;
        }
        auto test = std::make_unique<TQueryCondition>(kind, left.position);
        Advance();
        test->operands.push_back(std::move(left));
        test->operands.push_back(ReadOperand());
        if (test->operands.back().isClass) {
            Fail("expected a property or a value, found the name of the class", test->operands.back().position);
        }
        return test;
    }
    FailExpected("=, <>, <, <=, >, >=, LIKE, IS or ISA");
}

TQueryParser::TPointer TQueryParser::ReadLike(TQueryOperand left)
{
    if (fToken.kind != TQueryToken::kText) {
        FailExpected("a pattern in quotes");
    }
    auto test = std::make_unique<TQueryCondition>(TQueryCondition::kLike, left.position);
    // The pattern is a literal, so it is compiled once for all instances.
    test->pattern = std::make_unique<TLikePattern>(fToken.text);
    test->operands.push_back(std::move(left));
    Advance();
    return test;
}

TQueryParser::TPointer TQueryParser::ReadIsNull(TQueryOperand left)
{
    const std::size_t position = left.position;
    const bool isNegated = TakeKeyword("NOT");
    if (!TakeKeyword("NULL")) {
        FailExpected(isNegated ? "NULL" : "NULL or NOT NULL");
    }
    auto test = std::make_unique<TQueryCondition>(TQueryCondition::kIsNull, position);
    test->operands.push_back(std::move(left));
    if (!isNegated) {
        return test;
    }
    // A NOT around the test spares a further kind of test.
    auto negation = std::make_unique<TQueryCondition>(TQueryCondition::kNot, position);
    negation->parts.push_back(std::move(test));
    return negation;
}

TQueryParser::TPointer TQueryParser::ReadIsA(TQueryOperand left)
{
    if (left.name.empty() && !left.isClass) {
        Fail("ISA asks for the class of a property or of the query's own class, not of a value", left.position);
    }
    Advance();
    auto test = std::make_unique<TQueryCondition>(TQueryCondition::kIsA, left.position);
    test->operands.push_back(std::move(left));
    if (fToken.kind == TQueryToken::kText) {
        test->className = fToken.text;
        Advance();
    } else {
        test->className = TakeName("the name of a class");
    }
    return test;
}

TQueryOperand TQueryParser::ReadOperand()
{
    TQueryOperand operand{std::string(), TCIMValue(), fToken.position, 0, false};
    if (fToken.kind == TQueryToken::kText) {
        operand.literal = TCIMValue(fToken.text);
    } else if (fToken.kind == TQueryToken::kNumber) {
        operand.literal = ReadNumber();
    } else if (IsKeyword("TRUE") || IsKeyword("FALSE")) {
        operand.literal = TCIMValue(IsKeyword("TRUE"));
    } else if (!IsKeyword("NULL")) {
        return ReadProperty();
    }
    Advance();
    return operand;
}

TQueryOperand TQueryParser::ReadProperty()
{
    TQueryOperand operand{std::string(), TCIMValue(), fToken.position, 0, false};
    operand.name = TakeName("a property or a value");
    if (TakeSymbol(".")) {
        if (!TNameText::Equal(operand.name, fQuery.fClassName)) {
            Fail("'" + operand.name + "' is not the class of this query", operand.position);
        }
        operand.name = TakeName("the name of a property");
        // In front of ISA the name of the class stands for the instance itself, not for a property.
    } else if (IsKeyword("ISA") && TNameText::Equal(operand.name, fQuery.fClassName)) {
        operand.name.clear();
        operand.isClass = true;
        return operand;
    }
    // The matcher keeps the slots of properties by this number.
    operand.ordinal = fProperties++;
    return operand;
}

TCIMValue TQueryParser::ReadNumber() const
{
    TCIMValue number;
    // The first type that can hold the number exactly; real64 takes the rest.
    for (const auto type : {TCIMValue::TCIMType::kUint64, TCIMValue::TCIMType::kSint64, TCIMValue::TCIMType::kReal64}) {
        if (TValueText::Parse(type, fToken.text, number)) {
            return number;
        }
    }
    Fail("'" + fToken.text + "' is no number", fToken.position);
}

}  // namespace NORVZEL20
