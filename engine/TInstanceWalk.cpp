#include "engine/TInstanceWalk.h"

#include <utility>

namespace NORVZEL20 {

bool TCIMDiffEngine::TInstanceWalk::operator()(boost::shared_ptr<ICIMInstance> instance)
{
    std::string key = BuildKey(instance);
    if (auto* const master = fState->masters.Find(key)) {
        Match(master->second, std::move(key), std::move(instance));
        return true;
    }
    auto& [missingKey, indices] = fState->missing.FindOrAdd(std::move(key));
    NoteMissing(missingKey, indices, *instance);
    return true;
}

}  // namespace NORVZEL20
