#include "client/commands/CollectFromCommand.h"

#include <sys/stat.h>
#include <unistd.h>

#include <boost/algorithm/hex.hpp>
#include <boost/algorithm/string/join.hpp>
#include <cctype>
#include <cerrno>
#include <memory>
#include <optional>
#include <vector>

#include "client/files/ListFolder.h"
#include "client/inventory/LoadFiles.h"
#include "client/process/ExitStatus.h"
#include "client/process/SystemError.h"
#include "client/process/TClientError.h"
#include "client/process/TProgress.h"
#include "client/report/TResultOutput.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"
#include "client/text/SomeOf.h"
#include "client/wbem/FindCredentials.h"
#include "client/wbem/FindNamespaces.h"
#include "client/wbem/TNamespaceCollector.h"
#include "embedded/cimxml/TCimXmlWriter.h"

namespace NORVZEL20 {

namespace {

const char kNoSuchNamespace[] = "3";  // CIM_ERR_INVALID_NAMESPACE

// A server, and what is collected from it.
class TServerCollection {
  public:
    TServerCollection(const TCollectFromOptions& options, IConsole& console) : fConsole(console)
    {
        TCurlTransport::TSettings transport;
        TWbemServer::TSettings server;
        server.address = ReadWbemAddress(options.server);
        server.limits.silence = options.silence;
        server.limits.total = options.timeLimit;
        server.limits.totalBytes = options.sizeLimit << 20U;
        server.limits.instances = options.instanceLimit;
        const auto onAsking = [this] { fProgress.reset(); };
        const auto onAnswered = [this] { ShowProgress(); };
        FindCredentials({options.hasNetrc, options.netrcFile, options.mayPassInTheOpen, onAsking, onAnswered}, transport, server);
        transport.address = server.address;
        transport.limits = server.limits;
        transport.caFile = options.caFile;
        if (!options.caFile.empty() && access(options.caFile.c_str(), R_OK) != 0) {
            throw TClientError(EscapeForDisplay(options.caFile) + " cannot be read", LastSystemError(), "; correct --ca");
        }
        fTransport = std::make_unique<TCurlTransport>(transport);
        fServer = std::make_unique<TWbemServer>(*fTransport, server);
    }

    // Errors: also TClientError that names the namespaces that there are, if this one is not among them.
    void CollectOne(const std::string& namespaceName, const std::string& path)
    {
        try {
            Collect(namespaceName, path);
        } catch (const TWbemFault& fault) {
            if (fault.GetStatus() == kNoSuchNamespace) {
                throw TClientError(DescribeMissing(namespaceName));
            }
            throw;
        }
    }

    // Returns whether all of them could be collected.
    bool CollectAll(const std::string& folder)
    {
        bool areAll = true;
        for (const std::string& name : RequireNamespaces()) {
            try {
                Collect(name, folder + "/" + FileNameOfNamespace(name));
            } catch (const TWbemFault& fault) {
                if (!fault.IsOfThisRequest()) {
                    throw;
                }
                fConsole.Say("cimdelta: not collected: namespace " + EscapeForDisplay(name) + ": " + fault.what());
                areAll = false;
            }
        }
        return areAll;
    }

  private:
    void Collect(const std::string& namespaceName, const std::string& path)
    {
        const TNamespaceCollector::TResult result = Read(namespaceName);
        SayNotCollected(result, namespaceName);
        SayTolerated(result.loaded, fConsole);
        TResultOutput output(fConsole, path);
        TCimXmlWriter writer([&output](std::string_view piece) { output.Write(piece); });
        writer.WriteNamespace(*result.ns, result.loaded.namespaceName, result.loaded.host);
        output.Deliver();
    }

    TNamespaceCollector::TResult Read(const std::string& namespaceName)
    {
        fDoing = "collecting " + EscapeForDisplay(namespaceName) + " from " + EscapeForDisplay(fServer->GetAddress().server);
        ShowProgress();
        TNamespaceCollector::TResult result = TNamespaceCollector(*fServer, namespaceName).Collect();
        fProgress.reset();
        return result;
    }

    void ShowProgress()
    {
        fProgress.emplace(fConsole, fDoing, [this] { return DescribeAmount(); });
    }

    std::string DescribeAmount()
    {
        const TWbemCounts& counts = fServer->GetCounts();
        return std::to_string(counts.finished) + " of " + Counted(counts.classes, "class", "classes") + ", " +
               Counted(counts.instances, "instance") + ", " + std::to_string(counts.bytes >> 20U) + " MiB";
    }

    std::string DescribeMissing(const std::string& namespaceName)
    {
        const std::vector<std::string> names = FindNamespaces(*fServer);
        const std::string advice = names.empty() ? "; name another one with --namespace"
                                                 : "; it has " + EscapeForDisplay(boost::algorithm::join(names, ", ")) +
                                                       ": name one of these with --namespace";
        return EscapeForDisplay(fServer->GetAddress().server) + ": the server has no namespace " + QuoteForDisplay(namespaceName) +
               advice;
    }

    std::vector<std::string> RequireNamespaces()
    {
        fDoing = "asking " + EscapeForDisplay(fServer->GetAddress().server) + " for its namespaces";
        ShowProgress();
        std::vector<std::string> names = FindNamespaces(*fServer);
        fProgress.reset();
        if (names.empty()) {
            throw TClientError(EscapeForDisplay(fServer->GetAddress().server) +
                               ": the server does not say which namespaces it has (it was asked in root/interop, interop,"
                               " root/PG_InterOp and root); name one with --namespace");
        }
        return names;
    }

    void SayNotCollected(const TNamespaceCollector::TResult& result, const std::string& namespaceName)
    {
        for (const TNotCollected& entry : result.notCollected) {
            fConsole.Say("cimdelta: not collected from " + namespaceName + ": " + entry.kind + " of " + SomeOf(entry.subjects) +
                         ": " + entry.reason);
        }
    }

    IConsole& fConsole;
    std::unique_ptr<TCurlTransport> fTransport;
    std::unique_ptr<TWbemServer> fServer;
    std::string fDoing;
    std::optional<TProgress> fProgress;  // while something is asked for; the counts of the server must outlive it
};

// The folder of --all-namespaces, which must be new or empty: files of an earlier collection would look like those of this one.
class TNewFolder {
  public:
    explicit TNewFolder(const std::string& path) : fPath(path)
    {
        if (mkdir(path.c_str(), 0777) == 0) {
            fIsMade = true;
        } else if (errno != EEXIST) {
            throw TClientError(EscapeForDisplay(path) + ": the folder cannot be made", LastSystemError());
        } else if (const TFolderListing found = ListFolder(path); !found.files.empty() || !found.others.empty()) {
            throw TClientError(EscapeForDisplay(path) +
                               ": found something there, expected an empty folder or nothing; name another one with --output");
        }
    }
    TNewFolder(const TNewFolder&) = delete;
    TNewFolder& operator=(const TNewFolder&) = delete;
    ~TNewFolder()
    {
        if (fIsMade) {
            rmdir(fPath.c_str());  // only if nothing was put into it
        }
    }

  private:
    const std::string fPath;
    bool fIsMade = false;
};

}  // namespace

std::string FileNameOfNamespace(const std::string& namespaceName)
{
    std::string name;
    for (const char c : namespaceName) {
        const auto byte = static_cast<unsigned char>(c);
        if (std::isalnum(byte) != 0 || c == '_' || (c == '.' && !name.empty())) {
            name += c;
        } else if (c == '/') {
            name += '-';
        } else {
            name += "%" + boost::algorithm::hex(std::string(1, c));
        }
    }
    return name + ".xml";
}

int RunCollectFrom(const TCollectFromOptions& options, IConsole& console)
{
    const std::string namespaceName = ReadNamespaceName(options.namespaceName);
    if (!options.takesAllNamespaces) {
        CheckOutput(options.output, {});
        TServerCollection(options, console).CollectOne(namespaceName, options.output);
        return kExitSuccess;
    }
    if (IsStandardOutput(options.output)) {
        throw TClientError("--all-namespaces writes a file for each namespace; name a folder for them with --output");
    }
    TServerCollection collection(options, console);
    const TNewFolder folder(options.output);
    return collection.CollectAll(options.output) ? kExitSuccess : kExitTrouble;
}

}  // namespace NORVZEL20
