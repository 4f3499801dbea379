#include "embedded/query/TQueryParser.h"

#include <utility>

#include "embedded/query/TQueryError.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

const char* const kKeywords[] = {"SELECT", "FROM", "WHERE", "AND", "OR", "NOT", "IS", "NULL", "LIKE", "ISA", "TRUE", "FALSE"};

bool IsAnyKeyword(const std::string& name)
{
    for (const char* const keyword : kKeywords) {
        if (TNameText::Equal(name, keyword)) {
            return true;
        }
    }
    return false;
}

const std::pair<const char*, TQueryCondition::EKind> kComparisons[] = {
    {"=", TQueryCondition::kEqual},          {"<>", TQueryCondition::kNotEqual},    {"!=", TQueryCondition::kNotEqual},
    {"<", TQueryCondition::kLess},           {"<=", TQueryCondition::kLessOrEqual}, {">", TQueryCondition::kGreater},
    {">=", TQueryCondition::kGreaterOrEqual}};

}  // namespace

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
    const std::string found = fToken.fKind == TQueryToken::kEnd ? "the end of the query" : "'" + fToken.fText + "'";
    Fail("expected " + expected + ", found " + found, fToken.fPosition);
}

bool TQueryParser::IsKeyword(const char* word) const
{
    return fToken.fKind == TQueryToken::kName && TNameText::Equal(fToken.fText, word);
}

bool TQueryParser::IsSymbol(const char* symbol) const
{
    return fToken.fKind == TQueryToken::kSymbol && fToken.fText == symbol;
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
    if (fToken.fKind != TQueryToken::kName || IsAnyKeyword(fToken.fText)) {
        FailExpected(expected);
    }
    std::string name = fToken.fText;
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
    fQuery.fClassPosition = fToken.fPosition;
    fQuery.fClassName = TakeName("the name of a class");
    TakeList();
    if (TakeKeyword("WHERE")) {
        fQuery.fCondition = ReadOr();
    }
    if (fToken.fKind != TQueryToken::kEnd) {
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
    TListed listed{std::string(), std::string(), fToken.fPosition};
    if (TakeSymbol("*")) {
        return listed;
    }
    listed.name = TakeName("* or the name of a property");
    if (TakeSymbol(".")) {
        listed.qualifier.swap(listed.name);
        listed.name = TakeSymbol("*") ? std::string() : TakeName("* or the name of a property");
    }
    return listed;
}

/// Takes over the list, now that the class is known; a * among the names makes the list one of everything.
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
    auto condition = std::make_unique<TQueryCondition>(TQueryCondition::kOr, fToken.fPosition);
    do {
        condition->fParts.push_back(ReadAnd());
    } while (TakeKeyword("OR"));
    return condition;
}

TQueryParser::TPointer TQueryParser::ReadAnd()
{
    auto condition = std::make_unique<TQueryCondition>(TQueryCondition::kAnd, fToken.fPosition);
    do {
        condition->fParts.push_back(ReadNot());
    } while (TakeKeyword("AND"));
    return condition;
}

TQueryParser::TPointer TQueryParser::ReadNot()
{
    const std::size_t position = fToken.fPosition;
    if (++fDepth > kMaxDepth) {
        Fail("conditions stand in each other more than " + std::to_string(kMaxDepth) + " deep", position);
    }
    TPointer condition;
    if (TakeKeyword("NOT")) {
        condition = std::make_unique<TQueryCondition>(TQueryCondition::kNot, position);
        condition->fParts.push_back(ReadNot());
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
    if (IsKeyword("ISA")) {
        return ReadIsA(std::move(left));
    }
    if (left.fIsClass) {
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
        auto test = std::make_unique<TQueryCondition>(kind, left.fPosition);
        Advance();
        test->fOperands.push_back(std::move(left));
        test->fOperands.push_back(ReadOperand());
        if (test->fOperands.back().fIsClass) {
            Fail("expected a property or a value, found the name of the class", test->fOperands.back().fPosition);
        }
        return test;
    }
    FailExpected("=, <>, <, <=, >, >=, LIKE, IS or ISA");
}

TQueryParser::TPointer TQueryParser::ReadLike(TQueryOperand left)
{
    if (fToken.fKind != TQueryToken::kText) {
        FailExpected("a pattern in quotes");
    }
    auto test = std::make_unique<TQueryCondition>(TQueryCondition::kLike, left.fPosition);
    test->fPattern = std::make_unique<TLikePattern>(fToken.fText);
    test->fOperands.push_back(std::move(left));
    Advance();
    return test;
}

TQueryParser::TPointer TQueryParser::ReadIsNull(TQueryOperand left)
{
    const std::size_t position = left.fPosition;
    const bool isNegated = TakeKeyword("NOT");
    if (!TakeKeyword("NULL")) {
        FailExpected(isNegated ? "NULL" : "NULL or NOT NULL");
    }
    auto test = std::make_unique<TQueryCondition>(TQueryCondition::kIsNull, position);
    test->fOperands.push_back(std::move(left));
    if (!isNegated) {
        return test;
    }
    auto negation = std::make_unique<TQueryCondition>(TQueryCondition::kNot, position);
    negation->fParts.push_back(std::move(test));
    return negation;
}

TQueryParser::TPointer TQueryParser::ReadIsA(TQueryOperand left)
{
    if (left.fName.empty() && !left.fIsClass) {
        Fail("ISA asks for the class of a property or of the query's own class, not of a value", left.fPosition);
    }
    Advance();
    auto test = std::make_unique<TQueryCondition>(TQueryCondition::kIsA, left.fPosition);
    test->fOperands.push_back(std::move(left));
    if (fToken.fKind == TQueryToken::kText) {
        test->fClassName = fToken.fText;
        Advance();
    } else {
        test->fClassName = TakeName("the name of a class");
    }
    return test;
}

TQueryOperand TQueryParser::ReadOperand()
{
    TQueryOperand operand{std::string(), TCIMValue(), fToken.fPosition, 0, false};
    if (fToken.fKind == TQueryToken::kText) {
        operand.fLiteral = TCIMValue(fToken.fText);
    } else if (fToken.fKind == TQueryToken::kNumber) {
        operand.fLiteral = ReadNumber();
    } else if (IsKeyword("TRUE") || IsKeyword("FALSE")) {
        operand.fLiteral = TCIMValue(IsKeyword("TRUE"));
    } else if (!IsKeyword("NULL")) {
        return ReadProperty();
    }
    Advance();
    return operand;
}

TQueryOperand TQueryParser::ReadProperty()
{
    TQueryOperand operand{std::string(), TCIMValue(), fToken.fPosition, 0, false};
    operand.fName = TakeName("a property or a value");
    if (TakeSymbol(".")) {
        if (!TNameText::Equal(operand.fName, fQuery.fClassName)) {
            Fail("'" + operand.fName + "' is not the class of this query", operand.fPosition);
        }
        operand.fName = TakeName("the name of a property");
    } else if (IsKeyword("ISA") && TNameText::Equal(operand.fName, fQuery.fClassName)) {
        operand.fName.clear();
        operand.fIsClass = true;
        return operand;
    }
    operand.fOrdinal = fProperties++;
    return operand;
}

TCIMValue TQueryParser::ReadNumber() const
{
    TCIMValue number;
    for (const auto type : {TCIMValue::TCIMType::kUint64, TCIMValue::TCIMType::kSint64, TCIMValue::TCIMType::kReal64}) {
        if (TValueText::Parse(type, fToken.fText, number)) {
            return number;
        }
    }
    Fail("'" + fToken.fText + "' is no number", fToken.fPosition);
}

}  // namespace NORVZEL20
