#include "tests/engine/NaiveComparison.h"

#include "tests/engine/TNaiveRun.h"

namespace NORVZEL20 {

std::string CompareNaively(TNaiveSet set)
{
    TNaiveRun run(set);
    std::string status;
    try {
        run.Go();
    } catch (const TNaiveFailure& failure) {
        status = "status " + std::to_string(failure.status) + "\n";
    }
    return run.Records() + run.Aliases() + status + run.Instances();
}

}  // namespace NORVZEL20
