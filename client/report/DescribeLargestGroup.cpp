// An option reaches the classes below the one that it names, so a group is what the option leaves out: the differences of the class
// and of those below it. It is a group of one property, or of the instances that not all have.
#include "client/report/DescribeLargestGroup.h"

#include "client/text/DisplayText.h"
#include "client/text/QuoteForShell.h"
#include "embedded/store/TInMemClass.h"

namespace NORVZEL20 {

namespace {

// Fewer are read faster than the advice.
constexpr std::size_t kFew = 8;

struct TLargest {
    std::size_t count = 0;
    std::string what;
    std::string excluded;
};

using TTree = std::vector<const TClassFindings*>;

// What was found in the class and below it.
TTree TreeOf(const TInMemNamespace& schema, const TFindings& findings, const std::string& className)
{
    TTree tree;
    for (const TClassFindings& cls : findings.classes) {
        const boost::shared_ptr<TInMemClass> declared = schema.FindClass(cls.className);
        if (cls.className == className || (declared && declared->IsSubclassOf(className))) {
            tree.push_back(&cls);
        }
    }
    return tree;
}

std::size_t CountPresences(const TTree& tree)
{
    std::size_t count = 0;
    for (const TClassFindings* const cls : tree) {
        count += cls->counts.onlyInReference + cls->counts.onlyInOthers;
    }
    return count;
}

std::size_t CountChanges(const TTree& tree, const std::string& property)
{
    std::size_t count = 0;
    for (const TClassFindings* const cls : tree) {
        const auto found = cls->changedProperties.find(property);
        count += found == cls->changedProperties.end() ? 0 : found->second;
    }
    return count;
}

std::size_t CountAll(const TTree& tree)
{
    std::size_t count = 0;
    for (const TClassFindings* const cls : tree) {
        count += cls->counts.GetTotal();
    }
    return count;
}

void Take(TLargest& largest, std::size_t count, const TTree& tree, const std::string& what, const std::string& name)
{
    if (count > largest.count) {
        largest = {count, what + (tree.size() > 1 ? " and classes below it" : ""), name};
    }
}

}  // namespace

std::string DescribeLargestGroup(const TInMemNamespace& schema, const TFindings& findings, std::size_t total)
{
    TLargest largest;
    for (const TClassFindings& cls : findings.classes) {
        const TTree tree = TreeOf(schema, findings, cls.className);
        if (CountPresences(tree) * 2 > total) {
            Take(largest, CountAll(tree), tree, "in " + cls.className, cls.className);
        }
        for (const auto& changed : cls.changedProperties) {
            const std::string name = cls.className + "." + changed.first;
            Take(largest, CountChanges(tree, changed.first), tree, name, name);
        }
    }
    if (largest.count <= kFew || largest.count * 2 <= total || largest.count == total) {
        return std::string();
    }
    return std::to_string(largest.count) + " of " + std::to_string(total) + " differences are " + EscapeForDisplay(largest.what) +
           ": --exclude " + EscapeForDisplay(QuoteForShell(largest.excluded)) + "\n";
}

}  // namespace NORVZEL20
