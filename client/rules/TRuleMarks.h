#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "client/rules/TRulesDocument.h"
#include "host/ICIMNamespace.h"
#include "spec/TDiffClassRules.h"

namespace NORVZEL20 {

/// Which element of a rules file decides what in each class, according to the plug-in's own merge.
///
/// Elements are known by their positions in the file. Class names count byte for byte.
class TRuleMarks {
  public:
    /// No element is merged yet. `elements` must outlive this.
    TRuleMarks(const std::vector<TRulesDocument::TElement>& elements, boost::shared_ptr<ICIMNamespace> schema);

    /// Merges the element into its class and hands the result down to all classes below it. Call this for each element, in the
    /// order of the file. Errors: those of the schema. Cost: that of the plug-in's merge, times the number of digits of a position.
    void Merge(std::size_t element);

    /// Whether the class's rules are final: no later element changes them.
    bool IsFinal(const std::string& className) const;

    /// The element whose default the class has; none if no element has reached it.
    std::optional<std::size_t> FindDefault(const std::string& className) const;
    /// The element whose excluded keys the class has; none if no element has reached it.
    std::optional<std::size_t> FindKeys(const std::string& className) const;
    /// The listed properties of the class, and the element that decides each.
    std::map<std::string, std::size_t> FindListed(const std::string& className) const;

  private:
    using TMarks = TCIMDiffEngine::TDiffClassRules;

    const TMarks* Find(const std::string& className) const;
    void Write(std::map<std::string, TCIMDiffEngine::propType>& marks, const std::string& property, std::size_t number) const;
    std::size_t Read(const TMarks& marks, const std::string& property) const;

    const std::vector<TRulesDocument::TElement>& fElements;
    boost::shared_ptr<ICIMNamespace> fSchema;
    std::size_t fDigits = 1;  // enough for every position
    TCIMDiffEngine::TRuleset fMarks;
};

}  // namespace NORVZEL20
