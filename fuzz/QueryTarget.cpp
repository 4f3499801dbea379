// Runs a text as a query, and as the condition of a query, over the sample.
//
// A condition is checked by its logic, so no expected answer is needed: the condition and its NOT share no instance, NOT NOT gives
// the condition back, OR of both gives the union of both answers, AND of both gives nothing. (A NULL makes a test neither true nor
// false, so a condition and its NOT together need not find every instance.)

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
        Promise(status == TZELStatusCode::kInvalidQuery || status == TZELStatusCode::kNotFound,
                "a query is refused with kNotFound (15) or kInvalidQuery (16)", std::to_string(status));
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

/// Checks the condition against its negations, as described above.
void CheckCondition(TInMemNamespace& ns, const std::string& condition)
{
    const std::string start = "SELECT * FROM Device WHERE ";
    const TAnswer found = Ask(ns, start + condition);
    if (!found.answered) {
        return;
    }
    const TAnswer negated = Ask(ns, start + "NOT (" + condition + ")");
    Promise(negated.answered, "a condition can be negated", condition);
    Promise(AreDisjoint(found.paths, negated.paths), "no instance answers a condition and its NOT", condition);
    const TAnswer twice = Ask(ns, start + "NOT NOT (" + condition + ")");
    Promise(twice.answered && twice.paths == found.paths, "NOT NOT gives the condition back", condition);
    const TAnswer either = Ask(ns, start + "(" + condition + ") OR NOT (" + condition + ")");
    TPaths both = found.paths;
    both.insert(negated.paths.begin(), negated.paths.end());
    Promise(either.answered && either.paths == both, "OR finds what either side finds", condition);
    const TAnswer neither = Ask(ns, start + "(" + condition + ") AND NOT (" + condition + ")");
    Promise(neither.answered && neither.paths.empty(), "AND finds what both sides find", condition);
}

}  // namespace

void FuzzQuery(std::string_view input)
{
    static const boost::shared_ptr<TInMemNamespace> fgSample = LoadSample();
    constexpr std::size_t kMostConditionBytes = 300;  // the condition is repeated in one query, whose depth is bounded
    const std::string text(input);
    Ask(*fgSample, text);
    if (text.size() <= kMostConditionBytes) {
        CheckCondition(*fgSample, text);
    }
}

}  // namespace NORVZEL20
