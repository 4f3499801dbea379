#include <gtest/gtest.h>

#include <atomic>
#include <condition_variable>
#include <functional>
#include <mutex>
#include <thread>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/services/TCoreLog.h"
#include "host/TZELException.h"
#include "tests/faults/DifferingNamespaces.h"
#include "tests/support/Dump.h"
#include "tests/support/TComparisonRun.h"
#include "tests/support/TScratchFile.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {
namespace {

const std::size_t kThreads = 8;

/// A barrier: threads wait until all have arrived.
class TStartLine {
  public:
    void Wait()
    {
        std::unique_lock<std::mutex> lock(fMutex);
        if (++fWaiting == kThreads) {
            fAllThere.notify_all();
        }
        fAllThere.wait(lock, [this] { return fWaiting == kThreads; });
    }

  private:
    std::mutex fMutex;
    std::condition_variable fAllThere;
    std::size_t fWaiting = 0;
};

/// Runs `work` on eight threads at the same time and returns their results.
std::vector<std::string> DoAtOnce(const std::function<std::string()>& work)
{
    TStartLine start;
    std::vector<std::string> results(kThreads);
    std::vector<std::thread> threads;
    for (std::string& result : results) {
        threads.emplace_back([&] {
            start.Wait();
            result = work();
        });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
    return results;
}

/// Checks that eight concurrent threads get the same results as one alone. The single thread comes last, so the threads start with
/// nothing initialised except the provider. Its first use must be on one thread, and loading its library is that use.
void ExpectAsAlone(const std::function<std::string()>& work)
{
    const std::vector<std::string> results = DoAtOnce(work);
    const std::string alone = work();
    EXPECT_NE("", alone);
    EXPECT_EQ(std::vector<std::string>(kThreads, alone), results);
}

/// Counts entries from all threads.
class TCountingLogger : public ILogger {
  public:
    TCountingLogger() : fBefore(TCoreLog::Set(this)) {}
    TCountingLogger(const TCountingLogger&) = delete;
    TCountingLogger& operator=(const TCountingLogger&) = delete;
    ~TCountingLogger() override { TCoreLog::Set(fBefore); }

    void Log(int, const std::string&) override { ++fCount; }
    std::size_t GetCount() const { return fCount; }

  private:
    ILogger* fBefore;
    std::atomic<std::size_t> fCount{0};
};

/// Runs a delta namespace over its own namespaces a few times. Returns the records and the reference as text.
std::string Compare(std::size_t namespaces, const std::string& rules)
{
    std::string text;
    for (int round = 0; round < 5; ++round) {
        const auto delta = MakeDeltaNamespace(EHost::kInmem);
        for (std::size_t index = 0; index < namespaces; ++index) {
            TNamespaceBuilder builder(MakeNamespace(EHost::kInmem, "root/cimv2"));
            FillDiffering(builder.OperatingSystem(), index);
            delta->AddNamespaceToCompareList(builder.GetNamespace());
        }
        delta->SetSpecFileName(rules);
        delta->FindDifferences();
        delta->FindDifferences();
        text += DumpRecords(TTestAccess::Store(*delta)) + DumpAliases(*delta) + DumpDiffering(TTestAccess::CompareList(*delta)[0]);
        TTestAccess::ForgetWrappers(*delta);
    }
    return text;
}

const char kDocumentHead[] =
    "<CIM CIMVERSION='2.0' DTDVERSION='2.0'><DECLARATION><DECLGROUP>"
    "<VALUE.OBJECT><CLASS NAME='Disk'><PROPERTY NAME='Id' TYPE='string'><QUALIFIER NAME='Key' TYPE='boolean'><VALUE>true</VALUE>"
    "</QUALIFIER></PROPERTY><PROPERTY NAME='Size' TYPE='uint64'/><PROPERTY NAME='Made' TYPE='datetime'/></CLASS></VALUE.OBJECT>";

std::string MakeDocument()
{
    std::string text = kDocumentHead;
    for (int number = 0; number < 200; ++number) {
        text += "<VALUE.OBJECT><INSTANCE CLASSNAME='Disk'><PROPERTY NAME='Id' TYPE='string'><VALUE>disk number " +
                std::to_string(number) + "</VALUE></PROPERTY><PROPERTY NAME='Size' TYPE='uint64'><VALUE>" +
                std::to_string(number * 512) +
                "</VALUE></PROPERTY><PROPERTY NAME='Made' TYPE='datetime'><VALUE>20240229120000.000000+060</VALUE></PROPERTY>"
                "</INSTANCE></VALUE.OBJECT>\n";
    }
    return text + "</DECLGROUP></DECLARATION></CIM>";
}

TEST(Threads, EightComparisonsOfTwoNamespacesAreAsOne)
{
    const TScratchFile rules(RulesForDiffering(true));
    ExpectAsAlone([&rules] { return Compare(2, rules.GetPath()); });
}

TEST(Threads, EightComparisonsOfThreeNamespacesAreAsOne)
{
    const TScratchFile rules(RulesForDiffering(false));
    ExpectAsAlone([&rules] { return Compare(3, rules.GetPath()); });
}

TEST(Threads, EightComparisonsThatFailLogEach)
{
    TCountingLogger log;
    const TScratchFile rules("<DifftoolSpec><class name='Nowhere'/></DifftoolSpec>");
    ExpectAsAlone([&rules]() -> std::string {
        try {
            return Compare(2, rules.GetPath());
        } catch (const TZELException& error) {
            return "status " + std::to_string(error.GetStatusCode().GetStatus());
        }
    });
    EXPECT_EQ(2 * (kThreads + 1), log.GetCount());
}

TEST(Threads, EightInventoriesLoadAsOne)
{
    const TScratchFile file(MakeDocument());
    ExpectAsAlone([&file] {
        const auto ns = MakeNamespace(EHost::kInmem, "root/cimv2");
        TCimXmlPopulator(ns).LoadFile(file.GetPath());
        return DumpInstances(ns, "Disk");
    });
}

TEST(Threads, EightQueriesOverNamespacesOfTheirOwnAreAsOne)
{
    const std::string document = MakeDocument();
    ExpectAsAlone([&document] {
        const auto ns = MakeNamespace(EHost::kInmem, "root/cimv2");
        TCimXmlPopulator(ns).LoadFromMemory(document.data(), document.size(), "disks.xml");
        std::string found;
        std::string language = "WQL";
        std::string query = "SELECT * FROM Disk WHERE Size > 100000 OR Id LIKE '%9'";
        const auto append = [&found](boost::shared_ptr<ICIMInstance> instance) {
            found += instance->GetReference({}).GetPath() + "\n";
            return true;
        };
        ns->ExecuteQuery(append, language, query, {});
        return found;
    });
}

/// Each thread recycles the contents of paths that are made without a namespace. One of these paths ends after all that its thread
/// keeps for that, the others on another thread than the one that made them.
TEST(Threads, PathsMayOutliveTheirThreadAndWhatItKeepsForThem)
{
    const auto makePath = [](int number) {
        TCIMReference path(boost::shared_ptr<ICIMNamespace>{}, {});
        path.SetClassName("Disk");
        path.AddKeyValue("Id", TCIMValue(number));
        return path;
    };
    std::mutex mutex;
    std::vector<TCIMReference> survivors;
    const auto work = [&]() -> std::string {
        thread_local TCIMReference fgLast;  // made before its thread keeps anything, so it is destroyed after that
        fgLast = makePath(0);
        std::string texts = fgLast.GetPath();
        for (int number = 1; number < 100; ++number) {
            const TCIMReference path = makePath(number);
            texts += " " + path.GetPath();
            const std::lock_guard<std::mutex> lock(mutex);
            survivors.push_back(number % 10 == 0 ? path : makePath(-number));
        }
        return texts;
    };
    ExpectAsAlone(work);
    ASSERT_EQ((kThreads + 1) * 99, survivors.size());
    std::size_t tens = 0;
    for (const TCIMReference& path : survivors) {
        tens += path.GetPath().find("=-") == std::string::npos ? 1 : 0;
    }
    EXPECT_EQ((kThreads + 1) * 9, tens);
}

}  // namespace
}  // namespace NORVZEL20
