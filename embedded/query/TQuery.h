#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <memory>
#include <string>
#include <vector>

#include "host/ICIMInstance.h"

namespace NORVZEL20 {

class TInMemNamespace;
struct TQueryCondition;

/// A query in WQL (or the basic level of CQL, DSP0202), parsed once and answered by any namespace.
///
///     query     = "SELECT" ( "*" | name *( "," name ) ) "FROM" name [ "WHERE" or ]
///     or        = and *( "OR" and )
///     and       = not *( "AND" not )
///     not       = "NOT" not | "(" or ")" | test
///     test      = operand ( "=" | "<>" | "!=" | "<" | "<=" | ">" | ">=" ) operand | operand "LIKE" text
///               | operand "IS" [ "NOT" ] "NULL" | operand "ISA" ( name | text )
///     operand   = name | text | number | "TRUE" | "FALSE" | "NULL"
///
/// Key words and names may be written in any letter case; a name may have the class's in front (`Disk.Size`). Text stands in single
/// or double quotes, a quote or backslash within it behind a backslash. LIKE knows % (any text), _ (one character), [a-z] and
/// [^a-z]. The answer holds whole instances, of the class and its subclasses, also where the query lists properties; a listed
/// property must be declared. A test with a NULL is neither true nor false, and so is its NOT; only IS NULL finds NULLs. Text
/// compares byte for byte, numbers by value whatever their types, datetimes as instants (asterisks: not true), references by path
/// text. ISA asks for the class of an embedded object or a reference, or, with the class's own name in front, of the instance.
/// Arrays can be tested for NULL alone.
class TQuery {
  public:
    /// `language` is "WQL" or "DMTF:CQL", in any letter case. Errors: TQueryError with status 16 or 17.
    TQuery(const std::string& language, const std::string& text);
    TQuery(const TQuery&) = delete;
    TQuery& operator=(const TQuery&) = delete;
    ~TQuery();

    const std::string& GetClassName() const noexcept { return fClassName; }
    /// The listed properties as written; empty for "*".
    const std::vector<std::string>& GetProperties() const noexcept { return fProperties; }

    /// Calls back for each instance that answers, class by class (the class itself, then each subclass with all below it), in order
    /// of insertion, until the callback returns false. Errors: TQueryError with status 15 where the class, or a property in the
    /// class and all below it, is not declared, 16 for a test that the property's type does not allow.
    void Execute(TInMemNamespace& ns, const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback) const;

  private:
    friend class TQueryParser;

    std::string fClassName;
    std::size_t fClassPosition = 0;
    std::vector<std::string> fProperties;
    std::vector<std::size_t> fPropertyPositions;
    std::unique_ptr<TQueryCondition> fCondition;  // null: every instance
};

}  // namespace NORVZEL20
