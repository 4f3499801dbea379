#include "client/rules/SayRuleWarnings.h"

#include <algorithm>

#include "client/rules/TRuleWarnings.h"
#include "client/text/Counted.h"

namespace NORVZEL20 {

namespace {

const std::size_t kMostWarnings = 10;

}  // namespace

void SayRuleWarnings(IConsole& console, const std::string& name, const TRulesDocument& document,
                     const boost::shared_ptr<ICIMNamespace>& schema, const std::string& advice)
{
    const TRuleTrace trace(document, schema);
    const TRuleWarnings warnings(document, trace, schema, true);
    const std::size_t count = warnings.Get().size();
    for (std::size_t i = 0; i < std::min(count, kMostWarnings); ++i) {
        const TRuleWarnings::TWarning& warning = warnings.Get()[i];
        console.Say("cimdelta: " + name + ":" + std::to_string(warning.line) + ": warning: " + warning.text);
    }
    if (count > kMostWarnings) {
        console.Say("cimdelta: " + name + ": " + Counted(count - kMostWarnings, "more warning") + advice);
    }
}

}  // namespace NORVZEL20
