#pragma once

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <fstream>
#include <string>
#include <vector>

#include "tests/client/Documents.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {

/// Compares made systems as a person does, in a folder of its own, and reads the report.
class TGroupedFixture : public TClientFixture {
  protected:
    void SetUp() override
    {
        fFolder = ::testing::TempDir() + "cimdelta-grouped-" + std::to_string(getpid());
        ASSERT_EQ(0, mkdir(fFolder.c_str(), 0700));
        ASSERT_EQ(0, chdir(fFolder.c_str()));
    }

    void TearDown() override
    {
        for (const std::string& name : fFiles) {
            unlink(name.c_str());
        }
        rmdir(fFolder.c_str());
    }

    /// An inventory to compare: the operating system and what `contents` declares and holds.
    void System(const std::string& name, const std::string& contents)
    {
        Write(name + ".xml", Document(NORVZEL20::System() + contents));
        fSystems.push_back(name + ".xml");
    }

    void Write(const std::string& name, const std::string& text)
    {
        std::ofstream(name) << text;
        fFiles.push_back(name);
    }

    std::string Compare(const std::vector<std::string>& options = {})
    {
        std::vector<std::string> arguments{"compare"};
        arguments.insert(arguments.end(), fSystems.begin(), fSystems.end());
        arguments.insert(arguments.end(), options.begin(), options.end());
        return Result(arguments);
    }

    /// What stands between the summary and the coverage.
    std::string Findings(const std::vector<std::string>& options = {})
    {
        const std::string report = Compare(options);
        const std::size_t begin = report.find("\n\n") + 2;
        return report.substr(begin, report.rfind("\n\n") + 1 - begin);
    }

    /// A class of plain texts, and its instances.
    static std::string PlainClass(const std::string& name, const std::vector<std::string>& properties)
    {
        std::string declarations = KeyProperty("Name");
        for (const std::string& property : properties) {
            declarations += Declaration(property, "string");
        }
        return Class(name, "", declarations);
    }

    static std::string Plain(const std::string& cls, const std::string& name, const std::string& property = std::string(),
                             const std::string& value = std::string())
    {
        return Instance(cls, Value("Name", name) + (property.empty() ? "" : Value(property, value)));
    }

    std::string fFolder;
    std::vector<std::string> fSystems;
    std::vector<std::string> fFiles;
};

}  // namespace NORVZEL20
