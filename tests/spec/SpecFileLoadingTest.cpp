#include <dlfcn.h>
#include <sys/resource.h>
#include <unistd.h>

#include <cstdint>
#include <exception>
#include <filesystem>
#include <fstream>
#include <new>
#include <optional>
#include <stdexcept>
#include <typeinfo>
#include <vector>

#include "host/TOSSpecific.h"
#include "host/TZELException.h"
#include "tests/spec/TSpecFixture.h"

// Null unless the program is built with the leak checker.
extern "C" void __lsan_disable() __attribute__((weak));
extern "C" void __lsan_enable() __attribute__((weak));

namespace {

std::optional<std::uint64_t> gFileSize;  // what the host shall say of any file
std::exception_ptr gSizeFailure;         // what the host shall throw instead
bool gIsMemoryShort = false;
std::vector<std::size_t> gBuffers;  // the sizes that were asked for

}  // namespace

// The form of new[] that returns a null pointer if there is no memory.
void* operator new[](std::size_t size, const std::nothrow_t&) noexcept
{
    gBuffers.push_back(size);
    if (gIsMemoryShort) {
        return nullptr;
    }
    try {
        return ::operator new[](size);
    } catch (const std::bad_alloc&) {
        return nullptr;
    }
}

namespace NORVZEL20 {

// Replaces the host's own operation in this program, so a test can choose the size.
std::uint64_t TOSSpecific::GetFileSize(std::string path)
{
    if (gSizeFailure) {
        std::rethrow_exception(gSizeFailure);
    }
    if (gFileSize) {
        return *gFileSize;
    }
    using TOperation = std::uint64_t (*)(std::string);
    static const auto original = reinterpret_cast<TOperation>(
        dlsym(RTLD_NEXT, "_ZN9NORVZEL2011TOSSpecific11GetFileSizeENSt7__cxx1112basic_stringIcSt11char_traitsIcESaIcEEE"));
    return original(path);
}

namespace {

constexpr std::uint64_t kLimit = 104857600;

class SpecFileLoadingTest : public TSpecFixture {
  protected:
    ~SpecFileLoadingTest() override
    {
        gFileSize.reset();
        gSizeFailure = nullptr;
        gIsMemoryShort = false;
    }

    static std::size_t OpenFiles()
    {
        std::size_t count = 0;
        for (int descriptor = 0; descriptor < 1024; ++descriptor) {
            count += lseek(descriptor, 0, SEEK_CUR) != -1 || errno != EBADF ? 1 : 0;
        }
        return count;
    }
};

TEST_F(SpecFileLoadingTest, AFileIsReadAndClosed)
{
    const std::size_t before = OpenFiles();
    EXPECT_EQ("Other include\n", Read("<DifftoolSpec><class name=\"Other\" default=\"include\"/></DifftoolSpec>"));
    EXPECT_EQ("", TakeLog());
    EXPECT_EQ(before, OpenFiles());
}

TEST_F(SpecFileLoadingTest, AMissingFileFailsAsTheHostSays)
{
    EXPECT_EQ("status 11", ReadFile("/nonexistent/rules.xml"));
    EXPECT_EQ("", TakeLog());
}

struct TSizeException : TZELException {
    using TZELException::TZELException;
};

TEST_F(SpecFileLoadingTest, WhatTheHostThrowsForTheSizePassesThroughAsItIs)
{
    const TScratchFile file("<DifftoolSpec/>");
    gSizeFailure = std::make_exception_ptr(TSizeException(TZELStatusCode::kNamespaceGone));
    try {
        fEngine->ReadSpecFile(file.GetPath());
        FAIL() << "nothing was thrown";
    } catch (const TZELException& error) {
        EXPECT_EQ(TZELStatusCode::kNamespaceGone, error.GetStatusCode().GetStatus());
        EXPECT_EQ(typeid(TSizeException), typeid(error));
    }
    gSizeFailure = std::make_exception_ptr(std::runtime_error("own"));
    EXPECT_THROW(fEngine->ReadSpecFile(file.GetPath()), std::runtime_error);
    EXPECT_EQ("", TakeLog());
}

TEST_F(SpecFileLoadingTest, AFileThatHasASizeButCannotBeOpenedIsReported)
{
    gFileSize = 10;
    EXPECT_EQ("status 11", ReadFile("/nonexistent/rules.xml"));
    EXPECT_EQ("", TakeLog());
}

TEST_F(SpecFileLoadingTest, AReadErrorIsReportedAndLeavesTheFileOpen)
{
    const std::size_t before = OpenFiles();
    gFileSize = 10;
    if (__lsan_disable) {
        __lsan_disable();
    }
    EXPECT_EQ("status 11", ReadFile("/tmp"));  // a folder can be opened, but not read
    if (__lsan_enable) {
        __lsan_enable();
    }
    EXPECT_EQ(before + 1, OpenFiles());
    EXPECT_EQ("", TakeLog());
}

TEST_F(SpecFileLoadingTest, WithoutMemoryTheFileIsNotRead)
{
    const TScratchFile file("<DifftoolSpec/>");
    gIsMemoryShort = true;
    EXPECT_EQ("status 4", ReadFile(file.GetPath()));
    gFileSize = kLimit;
    EXPECT_EQ("status 4", ReadFile("/nonexistent/rules.xml"));
    EXPECT_EQ("", TakeLog());
}

TEST_F(SpecFileLoadingTest, AFileAboveTheLimitIsRefusedBeforeItIsOpened)
{
    gIsMemoryShort = true;
    for (const std::uint64_t size : {kLimit + 1, std::uint64_t(1) << 32, (std::uint64_t(1) << 32) + 10, ~std::uint64_t(0)}) {
        gFileSize = size;
        EXPECT_EQ("status 9", ReadFile("/nonexistent/rules.xml")) << size;
        EXPECT_EQ("", TakeLog());
    }
}

TEST_F(SpecFileLoadingTest, AFileAtTheLimitIsRead)
{
    const TScratchFile file("<DifftoolSpec><class name=\"Other\"/></DifftoolSpec>");
    {
        std::ofstream out(file.GetPath(), std::ios::app);
        out << std::string(kLimit - std::filesystem::file_size(file.GetPath()), ' ');
    }
    ASSERT_EQ(kLimit, std::filesystem::file_size(file.GetPath()));
    EXPECT_EQ("Other exclude\n", ReadFile(file.GetPath()));
    std::ofstream(file.GetPath(), std::ios::app) << ' ';
    EXPECT_EQ("status 9", ReadFile(file.GetPath()));
    EXPECT_EQ("", TakeLog());
}

TEST_F(SpecFileLoadingTest, AnEmptyFileFailsInTheParser)
{
    EXPECT_EQ("status 9", Read(""));
    EXPECT_EQ("0|Diff-XML Parser line 1:no element found|", TakeLog());
}

TEST_F(SpecFileLoadingTest, TheParserGetsTheFilesBytesAndNoMore)
{
    EXPECT_EQ("", Read("<DifftoolSpec/>"));
    EXPECT_EQ("status 9", Read(std::string("<DifftoolSpec/>\0", 16)));
    EXPECT_EQ("status 9", Read(std::string("<DifftoolSpec/>\0<x/>", 20)));
}

TEST_F(SpecFileLoadingTest, TheBufferHasTheFilesSizeToTheByte)
{
    for (const std::size_t blanks : {0u, 1u, 4096u}) {
        const std::string document = "<DifftoolSpec/>" + std::string(blanks, ' ');
        gBuffers.clear();
        EXPECT_EQ("", Read(document));
        EXPECT_EQ(std::vector<std::size_t>{document.size()}, gBuffers);
    }
    gBuffers.clear();
    EXPECT_EQ("status 9", Read(""));
    EXPECT_EQ(std::vector<std::size_t>{0}, gBuffers);
}

TEST_F(SpecFileLoadingTest, AFileThatShrankIsReadAsItIs)
{
    const TScratchFile file("<DifftoolSpec/>");
    gFileSize = 1000;
    EXPECT_EQ("", ReadFile(file.GetPath()));
}

TEST_F(SpecFileLoadingTest, AFileThatGrewIsReadUpToTheSizeItHad)
{
    const TScratchFile file("<DifftoolSpec/><!-- open");
    gFileSize = 15;
    EXPECT_EQ("", ReadFile(file.GetPath()));
}

TEST_F(SpecFileLoadingTest, AParseErrorGivesBackFileAndMemory)
{
    const std::size_t before = OpenFiles();
    EXPECT_EQ("status 9", Read("<DifftoolSpec>"));
    EXPECT_EQ(before, OpenFiles());
}

}  // namespace
}  // namespace NORVZEL20
