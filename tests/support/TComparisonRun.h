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

/// The host that provides the namespaces of a test.
enum class EHost {
    kPlain,  ///< tests/support/plain, which checks nothing
    kInmem   ///< the embedded host's provider "inmem"
};

std::ostream& operator<<(std::ostream& out, EHost host);

/// A new, empty namespace.
boost::shared_ptr<ICIMNamespace> MakeNamespace(EHost host, const std::string& name);
/// A delta namespace with its schema. With kPlain its store is a plain namespace, with kInmem the provider makes it.
boost::shared_ptr<TDeltaNamespace> MakeDeltaNamespace(EHost host);

/// A delta namespace with the namespaces that it compares and its specification. All are watched.
///
/// A namespace is made when it is first asked for, with KALMO_OperatingSystem. All join the compare list at the first run.
class TComparisonRun {
  public:
    explicit TComparisonRun(EHost host);
    TComparisonRun(const TComparisonRun&) = delete;
    TComparisonRun& operator=(const TComparisonRun&) = delete;
    ~TComparisonRun();

    /// The namespace at that position. Makes it, and all before it, if they are missing.
    TNamespaceBuilder& Namespace(std::size_t index);
    /// How many namespaces to make if the test asks for fewer.
    void SetNamespaceCount(std::size_t count);
    /// Whether namespaces that are made later get KALMO_OperatingSystem.
    void SetWithOperatingSystem(bool with) { fWithOperatingSystem = with; }

    /// Writes the text to a file and makes it the specification.
    void Rules(const std::string& xml);
    const std::string& GetRulesPath() const;

    /// Adds the namespaces to the compare list.
    void Prepare();
    /// Prepares and finds the differences. Returns "", or for example `status 37` for an exception.
    std::string Run();
    /// The records in the store.
    std::string Records() const;
    /// Calls Run, then Records. A status comes last in the text.
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
