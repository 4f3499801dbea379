#pragma once

#include <boost/shared_ptr.hpp>
#include <cstddef>
#include <set>
#include <string>
#include <vector>

#include "client/rules/TRuleTrace.h"
#include "client/rules/TRules.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

/// Rules as they mean something for each class, to be changed class by class and then written as a rules file.
///
/// Names may be in any letter case; they are written as the schema spells them. What rules cannot say is refused or done in
/// another way, see the operations. Threads: one at a time.
class TRulesDraft {
  public:
    using TNames = std::set<std::string, TNameText::TLess>;

    /// What is compared of the instances of one class.
    struct TClass {
        std::string name;
        std::size_t parent = 0;    ///< the position of the class above it
        std::size_t treeEnd = 0;   ///< the position behind the last of the classes below it
        bool isByDefault = false;  ///< whether properties that nothing names are compared
        std::set<std::string> compared;
        std::vector<std::string> declared;  ///< all properties, in the order of the class
        std::vector<std::string> keys;      ///< those of them that are keys
        std::vector<std::string> excludedKeys;
        std::vector<std::string> remarks;  ///< why, for those who read the file
    };

    /// `rules` are those for the schema, the reference. Rules that cimdelta made for everything also stand for classes that are
    /// not known yet. Errors: those of the schema.
    TRulesDraft(const boost::shared_ptr<TInMemNamespace>& schema, TRules& rules, bool areMade);

    /// Each class stands before those below it, and these before the next class beside it. The first one is the pseudo-class above
    /// all classes, which has no properties.
    const std::vector<TClass>& GetClasses() const { return fClasses; }

    /// Leaves out the class alone, without those below it.
    void LeaveOut(std::size_t position);
    /// Leaves out the properties of the class alone. A class whose compared properties all go is still compared in whether its
    /// instances are there, by a key that is not among `names`; rules can say that only if there is such a key. Without one, the
    /// class is left out.
    void LeaveOutProperties(std::size_t position, const TNames& names);
    /// Leaves out all other properties of the class alone. If none is left, so is the class.
    void CompareOnly(std::size_t position, const TNames& names);
    /// Leaves a key out of what identifies instances of the class alone, and out of the compared properties. Nothing happens if
    /// the class has no such key.
    void ExcludeKey(std::size_t position, const std::string& key);
    /// Adds a line of text to the rules of the class.
    void Remark(std::size_t position, const std::string& remark) { fClasses[position].remarks.push_back(remark); }

    /// A rules file that means this for the schema. `heading` becomes a comment at its beginning, line by line.
    std::string Write(const std::vector<std::string>& heading) const;

  private:
    void Add(const boost::shared_ptr<TInMemClass>& cls, std::size_t parent, TRules& rules, const TRuleTrace& trace);

    std::vector<TClass> fClasses;
};

}  // namespace NORVZEL20
