// Reads a file of accepted differences. What is written of it reads as the same, says no less, and is the same after another round.

#include "client/baseline/ReadBaseline.h"
#include "client/process/TClientError.h"
#include "fuzz/Promise.h"
#include "fuzz/TFuzzTarget.h"

namespace NORVZEL20 {

void FuzzBaseline(std::string_view input)
{
    std::string written;
    std::size_t entries = 0;
    try {
        const TBaseline baseline = ParseBaseline(input, "fuzz.txt");
        written = baseline.ToText();
        entries = baseline.GetEntries().size();
        for (const TAcceptedDifference& entry : baseline.GetEntries()) {
            const std::string property = entry.kind == TDifference::kChanged ? entry.values.front().property : std::string();
            for (const std::string& label : entry.inventories) {
                Promise(baseline.Find(entry.kind, entry.instance, property, label).has_value(), "an entry is found by its labels");
            }
        }
    } catch (const TClientError& error) {
        const std::string message = error.what();
        return Promise(message.rfind("fuzz.txt:", 0) == 0, "an error names the file", message);
    }
    const TBaseline again = ParseBaseline(written, "written.txt");
    Promise(again.GetEntries().size() == entries, "what was written has as many entries", written);
    PromiseEqual(written, again.ToText(), "what was written is written again as it is");
}

}  // namespace NORVZEL20
