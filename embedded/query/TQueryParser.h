#pragma once

#include <memory>
#include <string>

#include "embedded/query/TQuery.h"
#include "embedded/query/TQueryCondition.h"
#include "embedded/query/TQueryLexer.h"

namespace NORVZEL20 {

/// Reads a query's text, one operation for each rule of the grammar (see TQuery).
class TQueryParser {
  public:
    /// How deep parentheses and NOTs may be nested.
    static constexpr unsigned int kMaxDepth = 200;

    /// Both must outlive the parser.
    TQueryParser(const std::string& text, TQuery& query);

    /// Fills the query. Errors: TQueryError with kInvalidQuery (16).
    void Parse();

  private:
    using TPointer = std::unique_ptr<TQueryCondition>;
    struct TListed {
        std::string qualifier;  ///< the name of the class in front; empty if there is none
        std::string name;       ///< empty for *
        std::size_t position;
    };

    void ReadList();
    void TakeList();
    TListed ReadListed();
    TPointer ReadOr();
    TPointer ReadAnd();
    TPointer ReadNot();
    TPointer ReadTest();
    TPointer ReadComparison(TQueryOperand left);
    TPointer ReadLike(TQueryOperand left);
    TPointer ReadIsNull(TQueryOperand left);
    TPointer ReadIsA(TQueryOperand left);
    TQueryOperand ReadOperand();
    TQueryOperand ReadProperty();
    TCIMValue ReadNumber() const;

    void Advance() { fToken = fLexer.Next(); }
    bool IsKeyword(const char* word) const;
    bool IsSymbol(const char* symbol) const;
    bool TakeKeyword(const char* word);
    bool TakeSymbol(const char* symbol);
    std::string TakeName(const char* expected);
    [[noreturn]] void Fail(const std::string& message, std::size_t position) const;
    [[noreturn]] void FailExpected(const std::string& expected) const;

    TQuery& fQuery;
    TQueryLexer fLexer;
    TQueryToken fToken;
    std::vector<TListed> fListed;
    std::size_t fProperties = 0;
    unsigned int fDepth = 0;
};

}  // namespace NORVZEL20
