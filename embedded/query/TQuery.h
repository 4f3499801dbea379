#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <memory>
#include <string>
#include <vector>

#include "host/Export.h"
#include "host/ICIMInstance.h"

namespace NORVZEL20 {

class TInMemNamespace;
struct TQueryCondition;

/// A query in WQL, or in the basic level of CQL (DSP0202). It is parsed once and can be run on any namespace.
///
///     query     = "SELECT" ( "*" | name *( "," name ) ) "FROM" name [ "WHERE" or ]
///     or        = and *( "OR" and )
///     and       = not *( "AND" not )
///     not       = "NOT" not | "(" or ")" | test
///     test      = operand ( "=" | "<>" | "!=" | "<" | "<=" | ">" | ">=" ) operand | operand "LIKE" text
///               | operand "IS" [ "NOT" ] "NULL" | operand "ISA" ( name | text )
///     operand   = name | text | number | "TRUE" | "FALSE" | "NULL"
///
/// - Key words and names may have any letter case. A name may follow that of the class (`Disk.Size`).
/// - Text is in single or double quotes, with a backslash in front of a quote or backslash within. LIKE takes a TLikePattern.
/// - The answer has whole instances of the class and its subclasses, even if the query lists properties. Those must be declared.
/// - A test with a NULL is neither true nor false, and so is its NOT. Only IS NULL finds NULLs.
/// - Text compares byte for byte, numbers by value even if their types differ, references by path text, datetimes as instants. A
///   test with asterisks in a datetime is neither true nor false. Arrays can only be tested for NULL.
/// - ISA tests the class of a reference or an embedded object. With the name of the query's class on the left it tests the class of
///   the instance itself.
///
/// Threads: as for the namespace that the query runs on.
class CIMDELTA_EXPORT TQuery {
  public:
    /// `language` is "WQL" or "DMTF:CQL", in any letter case.
    /// Errors: TQueryError with kInvalidQuery (16) or kQueryLanguageUnknown (17).
    TQuery(const std::string& language, const std::string& text);
    TQuery(const TQuery&) = delete;
    TQuery& operator=(const TQuery&) = delete;
    ~TQuery();

    const std::string& GetClassName() const noexcept { return fClassName; }
    /// The listed properties in the spelling of the query; empty for "*".
    const std::vector<std::string>& GetProperties() const noexcept { return fProperties; }

    /// Calls back with each instance of the answer until the callback returns false: class by class, first the class itself, then
    /// each subclass followed by those below it; the instances of a class in order of insertion.
    /// Errors: TQueryError with kNotFound (15) for a class that is not declared and for a property that neither the class nor any
    /// class below it declares, kInvalidQuery (16) for a test that a property's type does not allow. No instance has been passed
    /// to the callback then.
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
