#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "client/inventory/NotCollected.h"
#include "client/wbem/TAnswerStore.h"
#include "client/wbem/TWbemServer.h"
#include "embedded/load/TLoadReport.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// Reads one namespace of a server as a whole: declarations, then the instances of all classes.
class TNamespaceCollector {
  public:
    /// What a namespace had. A plain value.
    struct TResult {
        boost::shared_ptr<TInMemNamespace> ns;
        TLoadReport loaded;
        std::vector<TNotCollected> notCollected;
    };

    /// The server must outlive this.
    TNamespaceCollector(TWbemServer& server, std::string namespaceName);

    /// Call this once. Errors: TWbemFault if the server cannot be asked, its declarations are of no use, or
    /// nothing could be collected; std::bad_alloc.
    TResult Collect();

  private:
    void ReadDeclarations();
    void ReadTree(TInMemClass& root);
    bool TryTree(const TInMemClass& cls, std::string& reason);
    std::size_t ReadInstances(const std::string& className);
    std::optional<std::size_t> ReadByPull(const std::string& className);
    std::size_t Pull(const std::string& className, bool& isLost);
    void Close(const std::string& className, const std::string& context);
    void CheckInstances(std::size_t first) const;
    void LeaveOut(const std::string& subject, const std::string& reason);
    void RequireSomething() const;
    TResult Load();

    TWbemServer& fServer;
    const std::string fNamespaceName;
    TAnswerStore fAnswers;
    boost::shared_ptr<TInMemNamespace> fSchema;  // the declarations alone
    bool fOffersPull = true;
    std::size_t fTreesRead = 0;
    std::vector<TNotCollected> fNotCollected;  // each reason once
};

}  // namespace NORVZEL20
