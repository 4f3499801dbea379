#pragma once

#include <gtest/gtest.h>
#include <unistd.h>

#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "client/CommandLine.h"
#include "tests/client/TFakeConsole.h"

namespace NORVZEL20 {

/// Runs commands as a person types them, in the folder tests/client/data, through RunClient.
class TClientFixture : public ::testing::Test {
  protected:
    void SetUp() override { ASSERT_EQ(0, chdir(CIMDELTA_CLIENT_TEST_DATA)); }

    void TearDown() override
    {
        for (const std::string& file : fScratch) {
            unlink(file.c_str());
        }
    }

    /// Runs the client; the outcome is in fStatus, fOut and fErr.
    void Run(const std::vector<std::string>& arguments)
    {
        std::vector<const char*> argv(1, "cimdelta");
        for (const std::string& argument : arguments) {
            argv.push_back(argument.c_str());
        }
        TFakeConsole console;
        console.fColored = fColored;
        console.fWidth = fWidth;
        console.fTerminal = fTerminal;
        fStatus = RunClient(static_cast<int>(argv.size()), argv.data(), console);
        fOut = console.fOut;
        fErr = console.fErr;
    }

    /// Runs a command that must succeed without a message. Returns its result.
    std::string Result(const std::vector<std::string>& arguments)
    {
        Run(arguments);
        EXPECT_EQ("", fErr);
        EXPECT_NE(2, fStatus);
        return fOut;
    }

    /// Runs a command that must end with trouble and without a result. Returns its messages.
    std::string Complaint(const std::vector<std::string>& arguments)
    {
        Run(arguments);
        EXPECT_EQ("", fOut);
        EXPECT_EQ(2, fStatus);
        return fErr;
    }

    /// Makes a file with that content, removed after the test. Returns its path, which ends in `name`.
    std::string Scratch(const std::string& name, const std::string& content)
    {
        const std::string path = ::testing::TempDir() + "cimdelta-test-" + std::to_string(getpid()) + "-" + name;
        std::ofstream(path, std::ios::binary) << content;
        fScratch.push_back(path);
        return path;
    }

    static std::string ReadFile(const std::string& path)
    {
        std::ifstream file(path, std::ios::binary);
        return std::string(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
    }

    /// The text with `name` in place of every occurrence of the path, because expectations cannot know the folder of scratch files.
    static std::string Shorten(std::string text, const std::string& path, const std::string& name)
    {
        for (std::size_t at = text.find(path); at != std::string::npos; at = text.find(path, at + name.size())) {
            text.replace(at, path.size(), name);
        }
        return text;
    }

    int fStatus = -1;
    std::string fOut;
    std::string fErr;
    bool fColored = false;
    std::size_t fWidth = 0;
    bool fTerminal = false;
    std::vector<std::string> fScratch;
};

}  // namespace NORVZEL20
