#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/rules/TRules.h"
#include "host/TZELStatusCode.h"
#include "provider/TDeltaNamespace.h"

namespace NORVZEL20 {

/// Finds the place at which a run of the plug-in failed, by going the plug-in's way once more. Use it right after the run.
class TFaultSearch {
  public:
    struct TCause {
        std::string text;    ///< file, class and property; empty if nothing was found
        std::string remedy;  ///< what would happen over completed schemas; empty if the run would fail there too
    };

    /// The arguments must outlive this. The inventories are those of the run, in its order, as the run has left them.
    TFaultSearch(const std::vector<TInventory>& inventories, TRules& rules) : fInventories(inventories), fRules(rules) {}

    /// What kept the run, which ended with `status`, from adding an instance to the reference. `records` are those of the run.
    /// Errors: TZELException of a namespace.
    TCause FindRefusedInstance(TDeltaNamespace& records, TZELStatusCode status) const;

    /// The first property of the first pair of instances that the run could not compare, or the first instance whose key it could
    /// not make. Errors: TZELException of a namespace. Cost: that of a run.
    TCause FindRefusedPair() const;

    /// The remedy for what an inventory lacks.
    static constexpr char kCompleted[] = "cimdelta declares and makes what is missing";

  private:
    TCause CheckClass(TInMemClass& cls, const std::vector<std::string>& properties) const;
    TCause CheckKeys(const TInventory& inventory, const std::string& className) const;
    TCause CheckPair(const ICIMInstance& master, const TInMemInstance& instance, const TInventory& inventory,
                     const std::vector<std::string>& properties) const;
    bool IsRefused(const TInMemClass& cls, const TCIMValue& master, const TCIMValue& other,
                   const TInMemPropertyDecl& declared) const;
    TCause CheckProperties(const TInMemClass& cls, const TInMemInstance& added, const std::string& key) const;
    TCause CheckNewKeys(const TInMemClass& cls, const TInMemInstance& added, const std::string& key) const;

    const std::vector<TInventory>& fInventories;
    TRules& fRules;
};

}  // namespace NORVZEL20
