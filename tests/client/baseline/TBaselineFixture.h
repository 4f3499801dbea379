#pragma once

#include <gtest/gtest.h>

#include <fstream>
#include <map>
#include <string>
#include <vector>

#include "tests/client/Documents.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {

/// Systems with disks, whose sizes are what changes, and the file of accepted differences between them.
class TBaselineFixture : public TClientFixture {
  protected:
    using TDisks = std::map<std::string, std::string>;

    void SetUp() override
    {
        TClientFixture::SetUp();
        fBaseline = Scratch("base.txt", "");
        unlink(fBaseline.c_str());
        System("web01", {{"sda", "1"}, {"sdb", "5"}});
    }

    /// The disks of a system and their sizes, from now on.
    void System(const std::string& label, const TDisks& disks)
    {
        std::string contents = NORVZEL20::System() +
                               Class("Disk", "", KeyProperty("Id") + Declaration("Size", "uint16") + Declaration("Note", "string"));
        for (const auto& [id, size] : disks) {
            contents += Instance("Disk", Value("Id", id) + Value("Size", size, "uint16"));
        }
        fSystems[label] = Scratch(label + ".xml", Document(contents));
    }

    std::string Compare(std::vector<std::string> options)
    {
        options.insert(options.begin(), "compare");
        for (const auto& [label, path] : fSystems) {
            options.push_back(label);
            options.back() += "=" + path;
        }
        Run(options);
        return Shorten(fStatus == 2 ? fErr : fOut, fBaseline, "base.txt");
    }

    void Accept(const std::vector<std::string>& options = {})
    {
        std::vector<std::string> all{"--accept", fBaseline};
        all.insert(all.end(), options.begin(), options.end());
        fReport = Compare(all);
        EXPECT_EQ("", fErr);
        EXPECT_EQ(0, fStatus);
    }

    /// The report without the lines on what was compared.
    std::string Since(const std::vector<std::string>& options = {})
    {
        std::vector<std::string> all{"--baseline", fBaseline};
        all.insert(all.end(), options.begin(), options.end());
        fReport = Compare(all);
        EXPECT_EQ("", fErr);
        return fReport.substr(0, fReport.rfind("\n\n") + 1);
    }

    /// The entries of the file.
    std::string Entries() const
    {
        const std::string text = ReadFile(fBaseline);
        EXPECT_EQ(fMark, text.substr(0, fMark.size()));
        return text.substr(fMark.size());
    }

    void WriteEntries(const std::string& entries) const { std::ofstream(fBaseline) << fMark << entries; }

    /// A system with what is given, from now on.
    void SystemWith(const std::string& label, const std::string& contents)
    {
        fSystems[label] = Scratch(label + ".xml", Document(NORVZEL20::System() + contents));
    }

    const std::string fMark = "cimdelta-baseline 1\n# Accepted differences, one a line. What stands behind # is the reason.\n\n";
    std::map<std::string, std::string> fSystems;  // their files by label, the reference first
    std::string fBaseline;
    std::string fReport;
};

}  // namespace NORVZEL20
