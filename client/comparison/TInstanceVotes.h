#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/comparison/TDifference.h"
#include "client/comparison/TPropertyOrder.h"

namespace NORVZEL20 {

/// What all inventories of a run have of one instance, and what most of them have. TMajorityView says how that is found.
class TInstanceVotes {
  public:
    /// `differences` are all those of the instance, at least one, of a run with so many inventories. Those in
    /// `uncompared` were not compared in the class, and neither have the instance nor lack it. `order` is that of the first
    /// inventory. The differences and the order must outlive this.
    TInstanceVotes(const std::vector<TDifference>& differences, std::size_t inventories, const std::vector<std::size_t>& uncompared,
                   TPropertyOrder& order);

    /// The differences from the majority, in the order of IDifferences, with the positions that TMajorityView gives.
    std::vector<TDifference> Differ() const;

  private:
    // One property: its values and who has them, and the value that most have.
    struct TProperty {
        std::string name;
        std::vector<TValueDifference::TGroup> values;
        std::size_t winner = 0;
    };

    enum EState { kHas, kLacks, kUncompared };

    void FindStates(const std::vector<std::size_t>& uncompared);
    void AddChange(const TValueDifference& change);
    void AddProperty(const std::string& name, std::vector<TValueDifference::TGroup> values);
    std::vector<std::size_t> Which(EState state) const;
    std::size_t CountInstances(std::size_t inventory) const;
    std::size_t FindWinner(const std::vector<TValueDifference::TGroup>& values) const;
    bool HoldsMajority() const;
    TDifference Start(TDifference::EKind kind, std::vector<std::size_t> inventories) const;
    TDifference Missing() const;
    TDifference Extra() const;
    TDifference Changed(const TProperty& property) const;

    const std::vector<TDifference>& fDifferences;
    TPropertyOrder& fOrder;
    std::vector<EState> fStates;  // of each inventory of the run
    std::vector<TProperty> fProperties;
};

}  // namespace NORVZEL20
