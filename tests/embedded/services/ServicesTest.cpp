#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <stdlib.h>

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <fstream>

#include "embedded/services/TAssertionFailure.h"
#include "embedded/services/TCoreLog.h"
#include "embedded/services/TProviderLibrary.h"
#include "embedded/services/TSpdLogger.h"
#include "host/TNamespaceProviderManager.h"
#include "host/TOSSpecific.h"
#include "host/TRootObject.h"
#include "tests/embedded/services/TNamedProvider.h"
#include "tests/support/StatusOf.h"
#include "tests/support/TCapturingLogger.h"

namespace NORVZEL20 {
namespace {

using testing::Contains;
using testing::EndsWith;
using testing::HasSubstr;

TEST(StatusTest, EachStatusHasItsText)
{
    std::string texts;
    for (const int status : {0, 1, 3, 4, 5, 9, 11, 12, 13, 14, 15, 16, 17, 18, 19, 31, 37, 38}) {
        texts += std::to_string(status) + " " +
                 TZELStatusCode(static_cast<TZELStatusCode::EStatusCode>(status)).TranslateStatusCode() + "\n";
    }
    EXPECT_EQ(
        "0 Success\n1 Not offered\n3 Initialization failed\n4 Out of memory\n5 Invalid parameter\n9 Parse error\n11 File error\n"
        "12 Already exists\n13 Type mismatch\n14 Key without a value\n15 Not found\n16 Invalid query\n17 Unknown query language\n"
        "18 Namespace is gone\n19 Class in use\n31 Not supported\n37 Schema mismatch\n38 Missing parameter\n",
        texts);
}

TEST(StatusTest, EveryOtherNumberHasOneText)
{
    for (const int status : {2, 6, 39, 63}) {
        EXPECT_EQ("Unknown status", TZELStatusCode(static_cast<TZELStatusCode::EStatusCode>(status)).TranslateStatusCode());
    }
}

TEST(StatusTest, AnExceptionHasTheTextOfItsStatus)
{
    const TZELException failure(TZELStatusCode::kNotSupported);
    EXPECT_STREQ("Not supported", failure.what());
    EXPECT_EQ(failure.what(), TZELStatusCode(TZELStatusCode::kNotSupported).TranslateStatusCode().c_str());
    EXPECT_EQ(TZELStatusCode::kNotSupported, failure.GetStatusCode().GetStatus());
}

TEST(CoreLogTest, AReplacedLoggerGetsTheEntriesUntilItIsRemoved)
{
    ILogger* const standard = TRootObject::GetCoreLogger();
    ASSERT_NE(nullptr, standard);
    {
        TCapturingLogger log;
        EXPECT_EQ(&log, TRootObject::GetCoreLogger());
        TRootObject::GetCoreLogger()->Log(0, "something went wrong");
        EXPECT_EQ("0|something went wrong|", log.Take());
    }
    EXPECT_EQ(standard, TRootObject::GetCoreLogger());
    EXPECT_EQ(standard, TCoreLog::Set(nullptr));
    EXPECT_EQ(standard, TRootObject::GetCoreLogger());
}

TEST(CoreLogTest, TheStandardLoggerWritesALineToStandardError)
{
    testing::internal::CaptureStdout();
    testing::internal::CaptureStderr();
    TSpdLogger logger;
    logger.Log(0, "it failed {} %s\n");
    logger.Log(1, "beware");
    logger.Log(2, "by the way");
    logger.Log(3, "detail");
    const std::string text = testing::internal::GetCapturedStderr();
    EXPECT_EQ("", testing::internal::GetCapturedStdout());
    EXPECT_EQ(3, std::count(text.begin(), text.end(), '\n')) << text;
    EXPECT_THAT(text, HasSubstr("[error]"));
    EXPECT_THAT(text, HasSubstr("it failed {} %s\n"));
    EXPECT_THAT(text, HasSubstr("[warning]"));
    EXPECT_THAT(text, EndsWith("by the way\n"));
}

TEST(AssertionTest, ANullPointerEndsTheCallAndIsLogged)
{
    TCapturingLogger log;
    const boost::shared_ptr<std::string> null;
    try {
        static_cast<void>(null->size());
        FAIL() << "dereferencing a null pointer went on";
    } catch (const TAssertionFailure& failure) {
        EXPECT_THAT(failure.what(), HasSubstr("px != 0"));
        EXPECT_THAT(failure.what(), HasSubstr("operator->"));
        EXPECT_THAT(failure.what(), HasSubstr("shared_ptr.hpp line "));
        EXPECT_EQ(std::string("0|") + failure.what() + "|", log.Take());
    }
}

TEST(AssertionTest, AMessageIsLogged)
{
    TCapturingLogger log;
    EXPECT_THROW(boost::assertion_failed_msg("a == b", "they differ", "Compare", "compare.cpp", 7), std::logic_error);
    EXPECT_EQ("0|Assertion failed: a == b (they differ) in Compare, compare.cpp line 7|", log.Take());
}

TEST(ProviderManagerTest, TheInMemoryProviderIsThereFromTheStart)
{
    const auto manager = TNamespaceProviderManager::GetInstance();
    EXPECT_EQ("inmem", manager->GetProviderNames().at(0));
    EXPECT_EQ("inmem", manager->FindProvider("inmem")->GetName(TCallContext()));
    EXPECT_EQ(manager, TRootObject::GetNamespaceProviderManager());
}

TEST(ProviderManagerTest, ASecondProviderOfANameIsRefusedAndTheFirstStays)
{
    const auto manager = TNamespaceProviderManager::GetInstance();
    const auto first = boost::make_shared<TNamedProvider>("twice");
    EXPECT_EQ(TZELStatusCode::kSuccess, manager->RegisterProvider(first).GetStatus());
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, manager->RegisterProvider(boost::make_shared<TNamedProvider>("twice")).GetStatus());
    EXPECT_EQ(first, manager->FindProvider("twice"));
    EXPECT_EQ(nullptr, manager->FindProvider("Twice")) << "names are compared byte for byte";
    EXPECT_EQ("twice", manager->GetProviderNames().back());
}

TEST(ProviderManagerTest, AProviderIsAskedForItsNameOnlyWhenItRegisters)
{
    const auto manager = TNamespaceProviderManager::GetInstance();
    const auto first = boost::make_shared<TNamedProvider>("asked once");
    const auto second = boost::make_shared<TNamedProvider>("asked once");
    manager->RegisterProvider(first);
    manager->RegisterProvider(second);
    manager->RegisterProvider(boost::make_shared<TNamedProvider>("another"));
    EXPECT_EQ(first, manager->FindProvider("asked once"));
    EXPECT_THAT(manager->GetProviderNames(), Contains("asked once"));
    EXPECT_EQ(1, first->GetQuestionCount());
    EXPECT_EQ(1, second->GetQuestionCount());
}

TEST(ProviderManagerTest, TheNameAtTheRegistrationStays)
{
    const auto manager = TNamespaceProviderManager::GetInstance();
    const auto provider = boost::make_shared<TNamedProvider>("at first");
    manager->RegisterProvider(provider);
    provider->Rename("at last");
    EXPECT_EQ(provider, manager->FindProvider("at first"));
    EXPECT_EQ(nullptr, manager->FindProvider("at last"));
    EXPECT_EQ("at first", manager->GetProviderNames().back());
}

TEST(ProviderManagerTest, ANullProviderIsRefused)
{
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, TNamespaceProviderManager::GetInstance()->RegisterProvider(nullptr).GetStatus());
}

TEST(OSSpecificTest, TheRootIsTheEnvironmentsOrTheBuildTrees)
{
    const char* const before = getenv("CIMDELTA_ROOT");
    const std::string kept = before != nullptr ? before : "";
    setenv("CIMDELTA_ROOT", "/some/where/", 1);
    EXPECT_EQ("/some/where/", TOSSpecific::GetZELRootPath());
    setenv("CIMDELTA_ROOT", "", 1);
    const std::string found = TOSSpecific::GetZELRootPath();
    unsetenv("CIMDELTA_ROOT");
    EXPECT_EQ(found, TOSSpecific::GetZELRootPath());
    EXPECT_TRUE(std::ifstream(found + "/data/deltaclasses.properties.xml").is_open()) << found;
    setenv("CIMDELTA_ROOT", kept.c_str(), 1);
}

TEST(OSSpecificTest, TheSizeOfAFileIsInBytes)
{
    const std::string path = testing::TempDir() + "cimdelta-size";
    std::ofstream(path) << "twelve bytes";
    EXPECT_EQ(12u, TOSSpecific::GetFileSize(path));
    std::remove(path.c_str());
    EXPECT_EQ(TZELStatusCode::kFileError, StatusOf([&] { TOSSpecific::GetFileSize(path); }));
    EXPECT_EQ(TZELStatusCode::kFileError, StatusOf([] { TOSSpecific::GetFileSize(testing::TempDir()); })) << "a folder is no file";
}

TEST(ProviderLibraryTest, ALibraryRegistersItsProvidersWhileItIsLoaded)
{
    const TProviderLibrary library = TProviderLibrary::Load(SAMPLE_PROVIDER_LIBRARY);
    EXPECT_EQ(SAMPLE_PROVIDER_LIBRARY, library.GetPath());
    EXPECT_EQ(std::vector<std::string>({"sample"}), library.GetProviderNames());
    EXPECT_NE(nullptr, TNamespaceProviderManager::GetInstance()->FindProvider("sample"));
    EXPECT_EQ(std::vector<std::string>(), TProviderLibrary::Load(SAMPLE_PROVIDER_LIBRARY).GetProviderNames()) << "loaded already";
}

TEST(ProviderLibraryTest, WhatCannotBeLoadedIsLogged)
{
    for (const char* const path : {"", "/nowhere/libnothing.so", "/proc/self/cmdline"}) {
        TCapturingLogger log;
        EXPECT_EQ(TZELStatusCode::kFileError, StatusOf([&] { TProviderLibrary::Load(path); })) << path;
        EXPECT_THAT(log.Take(), testing::StartsWith("0|Cannot load provider library \"" + std::string(path) + "\": "));
    }
}

}  // namespace
}  // namespace NORVZEL20
