// Compares random namespaces with the plug-in and with a naive comparison, and requires the same records from both.
//
// The input chooses everything: its first byte the host, every further byte is one throw of the dice with which namespaces, rules
// and instances are made. An input that is too short goes on with zeros. Changing one byte changes one decision, which lets the
// fuzzer vary a set of namespaces a little at a time.

#include "fuzz/Promise.h"
#include "fuzz/TFuzzTarget.h"
#include "tests/engine/NaiveComparison.h"
#include "tests/engine/RandomSet.h"
#include "tests/engine/SetBuilding.h"

namespace NORVZEL20 {

void FuzzEngine(std::string_view input)
{
    const bool isInmem = !input.empty() && input[0] % 2 != 0;
    std::size_t next = 0;
    const auto throwDice = [&input, &next] { return ++next < input.size() ? static_cast<unsigned char>(input[next]) : 0U; };
    TNaiveSet set = MakeRandomSet(throwDice, isInmem);
    set.areListsBags = isInmem;
    const std::string expected = CompareNaively(set);
    PromiseEqual(expected, CompareByPlugIn(set, isInmem ? EHost::kInmem : EHost::kPlain),
                 "the plug-in finds what a naive comparison finds under the rules\n" + RulesOf(set));
}

}  // namespace NORVZEL20
