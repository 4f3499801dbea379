#include "client/report/DescribeLargestGroup.h"

#include "client/text/DisplayText.h"
#include "client/text/QuoteForShell.h"

namespace NORVZEL20 {

namespace {

// Fewer are read faster than the advice.
constexpr std::size_t kFew = 8;

struct TLargest {
    std::size_t count = 0;
    std::string what;
    std::string excluded;
};

void Take(TLargest& largest, std::size_t count, const std::string& what, const std::string& excluded)
{
    if (count > largest.count) {
        largest = {count, what, excluded};
    }
}

}  // namespace

std::string DescribeLargestGroup(const TFindings& findings, std::size_t total)
{
    TLargest largest;
    for (const TClassFindings& cls : findings.classes) {
        Take(largest, cls.counts.onlyInReference + cls.counts.onlyInOthers, "instances of " + cls.className + " that not all have",
             cls.className);
        for (const auto& [property, count] : cls.changedProperties) {
            const std::string name = cls.className + "." + property;
            Take(largest, count, name, name);
        }
    }
    if (largest.count <= kFew || largest.count * 2 <= total) {
        return std::string();
    }
    return std::to_string(largest.count) + " of " + std::to_string(total) + " differences are " + EscapeForDisplay(largest.what) +
           ": --exclude " + EscapeForDisplay(QuoteForShell(largest.excluded)) + "\n";
}

}  // namespace NORVZEL20
