#pragma once

#include <string>
#include <vector>

#include "tests/client/Documents.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {

/// Compares any number of documents that the test itself contains. Reports call them "a", "b", "c" in their order.
class TDocumentsFixture : public TClientFixture {
  protected:
    /// Under these rules, without the root element, from now on.
    void Rules(const std::string& elements)
    {
        fOptions = {"--spec", Scratch("rules", "<DifftoolSpec>" + elements + "</DifftoolSpec>")};
    }

    /// The report of the comparison or the messages, with an instance of KALMO_OperatingSystem in every document.
    std::string Compare(const std::vector<std::string>& documents, const std::vector<std::string>& options = {})
    {
        std::vector<std::string> arguments{"compare"};
        std::string prefix;
        for (const std::string& contents : documents) {
            const std::string name(1, static_cast<char>('a' + arguments.size() - 1));
            const std::string path = Scratch(name + ".xml", Document(System() + contents));
            prefix = path.substr(path.rfind('/') + 1, path.size() - path.rfind('/') - 1 - name.size() - 4);
            arguments.push_back(path);
        }
        arguments.push_back("--detail");
        arguments.insert(arguments.end(), fOptions.begin(), fOptions.end());
        arguments.insert(arguments.end(), options.begin(), options.end());
        Run(arguments);
        return Shorten(Shorten(fStatus == 2 ? fErr : fOut, ::testing::TempDir(), ""), prefix, "");
    }

    /// What stands in the report between the headline and the coverage.
    std::string Differences(const std::vector<std::string>& documents)
    {
        const std::string report = Compare(documents);
        const std::size_t begin = report.find("\n\n") + 2;
        return fStatus == 1 ? report.substr(begin, report.find("\n\nCompared: ") + 1 - begin) : report;
    }

    /// The first line of the report.
    std::string Headline(const std::vector<std::string>& documents)
    {
        const std::string report = Compare(documents);
        return report.substr(0, report.find('\n'));
    }

    /// The differences as NDJSON, without the coverage.
    std::string Lines(const std::vector<std::string>& documents)
    {
        const std::string report = Compare(documents, {"-o", "ndjson"});
        return report.substr(0, report.find("{\"kind\":\"coverage\""));
    }

    std::vector<std::string> fOptions;
};

}  // namespace NORVZEL20
