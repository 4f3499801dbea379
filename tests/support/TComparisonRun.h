#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <memory>
#include <ostream>
#include <string>
#include <vector>

#include "provider/TDeltaNamespace.h"
#include "tests/support/TNamespaceBuilder.h"
#include "tests/support/TScratchFile.h"
#include "tests/support/watched/TCallWatch.h"

namespace NORVZEL20 {

/// Whose namespaces a test uses.
enum class EHost {
    kPlain,  ///< those of tests/support, which check nothing
    kInmem   ///< those of the embedded host's provider "inmem"
};

std::ostream& operator<<(std::ostream& out, EHost host);

/// A new, empty namespace.
boost::shared_ptr<ICIMNamespace> MakeNamespace(EHost host, const std::string& name);
/// A delta namespace with its schema: with kPlain around a plain store, with kInmem the provider's own.
boost::shared_ptr<TDeltaNamespace> MakeDeltaNamespace(EHost host);

/// A delta namespace, the namespaces it compares, and its specification, all watched.
///
/// The namespaces are made as they are named, each with KALMO_OperatingSystem; they join the compare list at the first run.
class TComparisonRun {
  public:
    explicit TComparisonRun(EHost host);
    TComparisonRun(const TComparisonRun&) = delete;
    TComparisonRun& operator=(const TComparisonRun&) = delete;
    ~TComparisonRun();

    /// The namespace at that position; made, with all before it, where it is not there yet.
    TNamespaceBuilder& Namespace(std::size_t index);
    /// Positions to be, where no builder is asked for.
    void SetNamespaceCount(std::size_t count);
    /// Whether namespaces to come get KALMO_OperatingSystem.
    void SetWithOperatingSystem(bool with) { fWithOperatingSystem = with; }

    /// Sets the specification to this text, kept in a file.
    void Rules(const std::string& xml);
    const std::string& GetRulesPath() const;

    /// Adds the namespaces to the compare list.
    void Prepare();
    /// Prepares, and finds the differences: "", or `status 37` for an exception with that status.
    std::string Run();
    /// The records in the store.
    std::string Records() const;
    /// Run and Records one after the other, a status last.
    std::string RecordsAfterRun();

    TCallWatch& GetWatch() { return *fWatch; }
    /// The delta namespace.
    TDeltaNamespace& Delta() { return *fDelta; }
    boost::shared_ptr<TDeltaNamespace> GetDelta() { return fDelta; }
    /// The namespace at that position, watched.
    boost::shared_ptr<ICIMNamespace> Watched(std::size_t index);
    std::vector<boost::shared_ptr<ICIMNamespace>> AllWatched();

  private:
    EHost fHost;
    bool fWithOperatingSystem = true;
    bool fPrepared = false;
    boost::shared_ptr<TCallWatch> fWatch;
    boost::shared_ptr<TDeltaNamespace> fDelta;
    boost::shared_ptr<ICIMNamespace> fStore;
    std::vector<std::unique_ptr<TNamespaceBuilder>> fBuilders;
    std::unique_ptr<TScratchFile> fRules;
};

}  // namespace NORVZEL20
