#include "embedded/store/FindDuplicate.h"

#include <unordered_set>

#include "host/ICIMInstance.h"

namespace NORVZEL20 {

std::string FindDuplicate(TInMemClass& cls)
{
    std::unordered_set<std::string> paths;
    std::string duplicate;
    cls.EnumerateInstances(
        [&](boost::shared_ptr<ICIMInstance> instance) {
            std::string path = instance->GetReference(TCallContext()).GetPath();
            if (!paths.insert(path).second) {
                duplicate = std::move(path);
            }
            return duplicate.empty();
        },
        false, TCallContext());
    return duplicate;
}

}  // namespace NORVZEL20
