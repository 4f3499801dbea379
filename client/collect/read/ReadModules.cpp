// The kernel's list of modules: name, size, how often it is used, the modules that use it, state, address.
//
//   nf_conntrack 204800 3 nft_ct,nf_nat,xt_conntrack, Live 0xffffffffc0a3d000
//   loop 40960 0 - Live 0xffffffffc0112000
//
// How often a module is used changes from moment to moment, so it is passed over; so is the address. Modules that
// end in _diag are passed over too: programs that look, such as ss, load them.
#include "client/collect/read/ReadModules.h"

#include <algorithm>

#include "client/collect/read/TTextLines.h"
#include "client/collect/read/TextPieces.h"
#include "client/text/NumberIn.h"

namespace NORVZEL20 {

namespace {

bool IsForLooking(std::string_view module)
{
    return EndsWith(module, "_diag");
}

}  // namespace

std::vector<TFacts> ReadModules(std::string_view text, TReadFaults& faults)
{
    std::vector<TFacts> modules;
    TTextLines lines(text);
    while (lines.Next()) {
        const std::vector<std::string_view> fields = SplitAtBlanks(lines.GetLine());
        const std::optional<std::uint64_t> size = fields.size() < 5 ? std::nullopt : NumberIn(fields[1]);
        if (!size) {
            faults.Add(lines.GetNumber(),
                       "found " + Quoted(lines.GetLine()) + ", expected a module with its size, users and state");
            continue;
        }
        if (IsForLooking(fields[0])) {
            continue;
        }
        std::vector<std::string> users = fields[3] == "-" ? std::vector<std::string>() : ListOf(fields[3], ',');
        users.erase(std::remove_if(users.begin(), users.end(), &IsForLooking), users.end());
        std::sort(users.begin(), users.end());
        modules.push_back(TFacts("KALMO_KernelModule")
                              .Key("Name", fields[0])
                              .Number("Size", *size)
                              .Text("State", fields[4])
                              .Texts("UsedBy", users));
    }
    return modules;
}

}  // namespace NORVZEL20
