#include "fuzz/Promise.h"
#include "fuzz/TFuzzTarget.h"
#include "tests/engine/NaiveComparison.h"
#include "tests/engine/RandomSet.h"
#include "tests/engine/SetBuilding.h"

namespace NORVZEL20 {

/// The first byte chooses the host, each further one is a throw of the dice that namespaces and rules are made with; zeros follow.
void FuzzEngine(std::string_view input)
{
    const bool isInmem = !input.empty() && input[0] % 2 != 0;
    std::size_t next = 0;
    const auto throwDice = [&input, &next] { return ++next < input.size() ? static_cast<unsigned char>(input[next]) : 0U; };
    TNaiveSet set = MakeRandomSet(throwDice, isInmem);
    set.areListsBags = isInmem;
    const std::string expected = CompareNaively(set);
    PromiseEqual(expected, CompareByPlugIn(set, isInmem ? EHost::kInmem : EHost::kPlain),
                 "the plug-in finds what a naive comparison finds, under the rules\n" + RulesOf(set));
}

}  // namespace NORVZEL20
