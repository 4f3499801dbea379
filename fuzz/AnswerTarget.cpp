// Reads answers of a WBEM server: whole, byte by byte and in small pieces. All of them say the same, or the same is wrong with
// them. What is found is within the bytes: no more instances and no longer texts than there are bytes.

#include <algorithm>

#include "client/wbem/TAnswerScan.h"
#include "fuzz/Promise.h"
#include "fuzz/TFuzzTarget.h"

namespace NORVZEL20 {

namespace {

/// What the answer says, or why it is none.
std::string DescribeAnswer(std::string_view input, std::size_t piece)
{
    std::size_t instances = 0;
    TAnswerScan scan([&instances] { ++instances; });
    for (std::size_t at = 0; at < input.size(); at += piece) {
        scan.Read(input.substr(at, piece));
    }
    const TWbemAnswer& answer = scan.Finish();
    // What follows in parentheses are Expat's words, which depend on how far it sees.
    const std::string whole = scan.DescribeFault();
    const std::string fault = whole.substr(0, whole.find(" ("));
    Promise(answer.instances == instances, "each instance is announced");
    Promise(instances <= input.size() && answer.names.size() <= input.size(), "there is no more than the bytes hold");
    Promise(!fault.empty() || (answer.isComplete && !answer.operation.empty()), "an answer without a fault is complete");
    std::string text = fault + "|" + answer.operation + "|" + answer.errorCode + "|" + answer.description + "|" + answer.context +
                       "|" + (answer.isEndOfSequence ? "end" : "") + "|" + std::to_string(instances);
    for (const std::string& name : answer.names) {
        text += "|" + name;
    }
    return text;
}

}  // namespace

void FuzzAnswer(std::string_view input)
{
    const std::string whole = DescribeAnswer(input, std::max<std::size_t>(1, input.size()));
    for (const std::size_t piece : {std::size_t{1}, std::size_t{7}}) {
        PromiseEqual(whole, DescribeAnswer(input, piece), "pieces do not matter");
    }
}

}  // namespace NORVZEL20
