#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <set>
#include <string>
#include <vector>

#include "embedded/store/TInMemNamespace.h"
#include "provider/TDeltaNamespace.h"

namespace NORVZEL20 {

/// Loads the inventory in a file, compressed or not.
boost::shared_ptr<TInMemNamespace> LoadInventory(const std::string& path);
/// Loads the inventory in a text.
boost::shared_ptr<TInMemNamespace> LoadInventoryText(const std::string& xml);
/// Writes the namespace as one CIM-XML document.
std::string WriteInventory(TInMemNamespace& ns);

/// A comparison of two inventory files through the plug-in, whose result has the form of ReadOracle.
class TInventoryRun {
  public:
    TInventoryRun(const std::string& reference, const std::string& other);

    /// Compares every property of the named classes.
    void Compare(const std::vector<std::string>& classes);

    /// The differences, a line each; see ReadOracle.
    std::set<std::string> Differences(bool withValues) const;

  private:
    std::string Describe(ICIMInstance& record, bool withValues) const;
    std::string ValuesOf(const std::string& path, const std::string& property) const;

    boost::shared_ptr<TInMemNamespace> fReference;
    boost::shared_ptr<TInMemNamespace> fOther;
    boost::shared_ptr<TDeltaNamespace> fDelta;
};

}  // namespace NORVZEL20
