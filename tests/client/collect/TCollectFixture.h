#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "client/CommandLine.h"
#include "tests/client/TFakeConsole.h"
#include "tests/client/collect/TMadeSystem.h"

namespace NORVZEL20 {

/// Collects from a made system, and shows or compares the inventories with the program's own commands.
class TCollectFixture : public ::testing::Test {
  protected:
    /// What `cimdelta` answers, with its messages in front; its exit status is in fStatus.
    std::string Run(std::vector<const char*> arguments)
    {
        arguments.insert(arguments.begin(), "cimdelta");
        TFakeConsole console;
        fStatus = RunClient(static_cast<int>(arguments.size()), arguments.data(), console);
        return console.fErr + console.fOut;
    }

    /// The differences between the system before and after a change, under the rules that come with the program, without the lines
    /// around them.
    std::string FoundAfter(const std::function<void(TMadeSystem&)>& change)
    {
        const std::string before = fSystem->CollectTo("before.xml");
        change(*fSystem);
        const std::string after = fSystem->CollectTo("after.xml");
        const std::string report = Run({"compare", "--spec", CIMDELTA_LINUX_RULES, before.c_str(), after.c_str()});
        if (fStatus == 0) {
            return "nothing";
        }
        const std::size_t begin = report.find("\n\n") + 2;
        return report.substr(begin, report.find("\n\n", begin) + 1 - begin);
    }

    /// The instances of a class in an inventory of the system. What was left out is in fLines then.
    std::string Show(const std::string& className, const TCollectionOptions& options = TCollectionOptions())
    {
        const std::string path = fSystem->CollectTo("shown.xml", options);
        fLines = fSystem->GetLines();
        return Run({"show", path.c_str(), className.c_str()});
    }

    void SetUpSystem() { fSystem = std::make_unique<TMadeSystem>(); }

    std::unique_ptr<TMadeSystem> fSystem = std::make_unique<TMadeSystem>();
    std::string fLines;
    int fStatus = -1;
};

}  // namespace NORVZEL20
