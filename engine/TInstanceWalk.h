#pragma once

#include "engine/TCompareInstances.h"
#include "engine/TMapCursor.h"
#include "engine/TMasterInstance.h"

namespace NORVZEL20 {

/// The TCompareInstances of a run. It does the same, but finds a key beside the one before it if it can (see TMapCursor).
///
/// Instances may come in any order; a namespace that delivers them in ascending order of their keys is cheapest. `state` is the
/// caller's and must outlive the enumeration. Copies share it.
class TCIMDiffEngine::TInstanceWalk : public TCompareInstances {
  public:
    struct TState {
        TMapCursor<std::map<std::string, TMasterInstance>> masters;
        TMapCursor<std::map<std::string, std::vector<int>>> missing;
    };

    TInstanceWalk(const TCompareInstances& compareInstances, TState* state) : TCompareInstances(compareInstances), fState(state) {}

    bool operator()(boost::shared_ptr<ICIMInstance> instance);

  private:
    TState* fState;
};

}  // namespace NORVZEL20
