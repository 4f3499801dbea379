#include <algorithm>
#include <iterator>
#include <set>

#include "embedded/query/TQuery.h"
#include "embedded/query/TQueryError.h"
#include "fuzz/Promise.h"
#include "fuzz/SampleInventory.h"
#include "fuzz/TFuzzTarget.h"

namespace NORVZEL20 {

namespace {

using TPaths = std::set<std::string>;

struct TAnswer {
    bool answered = false;
    TPaths paths;
};

TAnswer Ask(TInMemNamespace& ns, const std::string& text)
{
    TAnswer answer;
    try {
        TQuery("WQL", text).Execute(ns, [&answer](boost::shared_ptr<ICIMInstance> instance) {
            return answer.paths.insert(instance->GetReference(TCallContext()).GetPath()).second;
        });
        answer.answered = true;
    } catch (const TQueryError& error) {
        const int status = error.GetStatusCode().GetStatus();
        Promise(status == TZELStatusCode::kInvalidQuery || status == TZELStatusCode::kNotFound, "a query is refused with 15 or 16",
                std::to_string(status));
        Promise(error.GetPosition() <= text.size(), "the position of an error lies in the text", error.what());
    }
    return answer;
}

bool AreDisjoint(const TPaths& left, const TPaths& right)
{
    TPaths common;
    std::set_intersection(left.begin(), left.end(), right.begin(), right.end(), std::inserter(common, common.end()));
    return common.empty();
}

/// What a condition finds, its NOT does not find, and either way round the parentheses change nothing.
void CheckCondition(TInMemNamespace& ns, const std::string& condition)
{
    const std::string start = "SELECT * FROM Device WHERE ";
    const TAnswer found = Ask(ns, start + condition);
    if (!found.answered)
        return;
    const TAnswer denied = Ask(ns, start + "NOT (" + condition + ")");
    Promise(denied.answered, "a condition can be denied", condition);
    Promise(AreDisjoint(found.paths, denied.paths), "nothing answers a condition and its denial", condition);
    const TAnswer twice = Ask(ns, start + "NOT NOT (" + condition + ")");
    Promise(twice.answered && twice.paths == found.paths, "a denial denied is the condition", condition);
    const TAnswer either = Ask(ns, start + "(" + condition + ") OR NOT (" + condition + ")");
    TPaths both = found.paths;
    both.insert(denied.paths.begin(), denied.paths.end());
    Promise(either.answered && either.paths == both, "OR finds what either side finds", condition);
    const TAnswer neither = Ask(ns, start + "(" + condition + ") AND NOT (" + condition + ")");
    Promise(neither.answered && neither.paths.empty(), "AND finds what both sides find", condition);
}

}  // namespace

void FuzzQuery(std::string_view input)
{
    static const boost::shared_ptr<TInMemNamespace> fgSample = LoadSample();
    constexpr std::size_t kMostConditionBytes = 300;  // a condition is repeated, and its depth is bounded
    const std::string text(input);
    Ask(*fgSample, text);
    if (text.size() <= kMostConditionBytes)
        CheckCondition(*fgSample, text);
}

}  // namespace NORVZEL20
