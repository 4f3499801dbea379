#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/value/TStubClass.h"
#include "tests/embedded/value/DateTimeOf.h"
#include "tests/embedded/value/ValuePrinter.h"
#include "tests/support/StatusOf.h"

namespace NORVZEL20 {
namespace {

constexpr int kParseError = TZELStatusCode::kParseError;

TCIMReference Path(const char* className)
{
    TCIMReference path;
    path.SetClassName(className);
    return path;
}

std::string BindingsOf(const TCIMReference& path)
{
    std::string text;
    path.EnumerateKeyBindings([&text](const std::pair<std::string, TCIMValue>& binding) {
        text +=
            binding.first + "=" + binding.second.ToText() + ":" + std::to_string(static_cast<int>(binding.second.GetType())) + " ";
        return true;
    });
    return text;
}

TEST(ReferenceTest, AnEmptyPathHasNoTextNoClassAndNoNamespace)
{
    const TCIMReference path;
    EXPECT_EQ("", path.GetPath());
    EXPECT_EQ(nullptr, path.GetClass());
    EXPECT_EQ(nullptr, path.GetNamespace());
    EXPECT_EQ("", path.GetNamespaceName());
    EXPECT_EQ("", path.GetHost());
    EXPECT_EQ("", path.GetClassName());
    EXPECT_EQ(0u, path.GetKeyCount());
    EXPECT_EQ(nullptr, path.FindKeyValue("Id"));
    EXPECT_EQ("", BindingsOf(path));
}

TEST(ReferenceTest, TextGrowsWithWhatIsKnown)
{
    TCIMReference path = Path("Disk");
    EXPECT_EQ("Disk", path.GetPath());
    path.AddKeyValue("Id", TCIMValue("sda"));
    EXPECT_EQ("Disk.Id=\"sda\"", path.GetPath());
    path.AddKeyValue("Bay", TCIMValue(5));
    EXPECT_EQ("Disk.Bay=5,Id=\"sda\"", path.GetPath());
    path.SetNamespaceName("/root/cimv2/");
    EXPECT_EQ("root/cimv2:Disk.Bay=5,Id=\"sda\"", path.GetPath());
    path.SetHost("web01:5989");
    EXPECT_EQ("//web01:5989/root/cimv2:Disk.Bay=5,Id=\"sda\"", path.GetPath());
}

TEST(ReferenceTest, TextIsAppended)
{
    std::string out = "Path: ";
    Path("Disk").AppendPath(out);
    EXPECT_EQ("Path: Disk", out);
}

TEST(ReferenceTest, BindingsStandInTheOrderOfTheirLowerCaseNamesAndKeepTheirSpelling)
{
    const TCIMReference path(nullptr, {{"b", TCIMValue(1)}, {"C", TCIMValue(2)}, {"A", TCIMValue(3)}});
    EXPECT_EQ(".A=3,b=1,C=2", path.GetPath());
    EXPECT_EQ("A=3:7 b=1:7 C=2:7 ", BindingsOf(path));
    EXPECT_EQ(3u, path.GetKeyCount());
}

TEST(ReferenceTest, ANameBoundAgainGetsTheNewValueAndKeepsItsSpelling)
{
    TCIMReference path = Path("Disk");
    path.AddKeyValue("Id", TCIMValue("sda"));
    path.AddKeyValue("ID", TCIMValue("sdb"));
    EXPECT_EQ("Disk.Id=\"sdb\"", path.GetPath());
    EXPECT_EQ("sdb", path.FindKeyValue("iD")->ToText());
    EXPECT_EQ(nullptr, path.FindKeyValue("Ide"));
}

TEST(ReferenceTest, EveryTypeOfKeyHasItsText)
{
    TCIMReference path = Path("C");
    path.AddKeyValue("a", TCIMValue("say \"hi\" \\ there"));
    path.AddKeyValue("b", TCIMValue(true));
    path.AddKeyValue("c", TCIMValue(u'\''));
    path.AddKeyValue("d", TCIMValue(DateTimeOf("20240101120000.000000+000")));
    path.AddKeyValue("e", TCIMValue(0.1f));
    path.AddKeyValue("f", TCIMValue::Null(TCIMValue::TCIMType::kString));
    path.AddKeyValue("g", TCIMValue(static_cast<signed char>(-1)));
    path.AddKeyValue("h", TCIMValue(false));
    path.AddKeyValue("i", TCIMValue(u'\\'));
    path.AddKeyValue("j", TCIMValue(""));
    EXPECT_EQ("C.a=\"say \\\"hi\\\" \\\\ there\",b=TRUE,c='\\'',d=\"20240101120000.000000+000\",e=0.1,f=NULL,g=-1,h=FALSE,"
              "i='\\\\',j=\"\"",
              path.GetPath());
}

TEST(ReferenceTest, AReferenceInAKeyIsQuotedPathText)
{
    TCIMReference disk = Path("Disk");
    disk.AddKeyValue("Id", TCIMValue("a\"b"));
    TCIMReference link = Path("Link");
    link.AddKeyValue("Part", TCIMValue(disk));
    EXPECT_EQ("Link.Part=\"Disk.Id=\\\"a\\\\\\\"b\\\"\"", link.GetPath());
    const TCIMReference again = TCIMReference::Parse(link.GetPath());
    EXPECT_EQ(disk.GetPath(), again.FindKeyValue("Part")->GetString());
}

TEST(ReferenceTest, EscapingKeepsTheKeysApart)
{
    TCIMReference two = Path("C");
    two.AddKeyValue("A", TCIMValue("1"));
    two.AddKeyValue("B", TCIMValue("1"));
    TCIMReference one = Path("C");
    one.AddKeyValue("A", TCIMValue("1\",B=\"1"));
    EXPECT_EQ("C.A=\"1\",B=\"1\"", two.GetPath());
    EXPECT_EQ("C.A=\"1\\\",B=\\\"1\"", one.GetPath());
}

TEST(ReferenceTest, ReferencesTooDeepInOneAnotherAreRefused)
{
    TCIMReference path = Path("C");
    for (int depth = 0; depth < 12; ++depth) {
        const TCIMValue inner(path);
        path.AddKeyValue("K", inner);
    }
    const std::string text = path.GetPath();
    const TCIMValue tooDeep(path);
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { path.AddKeyValue("K", tooDeep); }));
    const TCIMValue hidden(TCIMValue::TCIMType::kReference, 1, {tooDeep});
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { path.AddKeyValue("L", hidden); }));
    EXPECT_EQ(text, path.GetPath()) << "the path is as it was";
}

TEST(ReferenceTest, CopiesAreIndependent)
{
    TCIMReference path = Path("Disk");
    path.AddKeyValue("Id", TCIMValue("sda"));
    TCIMReference copy(path);
    copy.AddKeyValue("Id", TCIMValue("sdb"));
    copy.SetHost("web01");
    copy.SetNamespaceName("root");
    EXPECT_EQ("Disk.Id=\"sda\"", path.GetPath());
    EXPECT_EQ("//web01/root:Disk.Id=\"sdb\"", copy.GetPath());
    TCIMReference second(copy);
    second.SetHost("");
    EXPECT_EQ("//web01/root:Disk.Id=\"sdb\"", copy.GetPath());
    path = copy;
    TCIMReference& same = path;
    path = same;
    EXPECT_EQ(copy.GetPath(), path.GetPath());
}

TEST(ReferenceTest, EnumerationStopsWhenTheCallbackSaysSo)
{
    TCIMReference path = Path("C");
    path.AddKeyValue("a", TCIMValue(1));
    path.AddKeyValue("b", TCIMValue(2));
    int calls = 0;
    path.EnumerateKeyBindings([&calls](const std::pair<std::string, TCIMValue>&) { return ++calls > 1; });
    EXPECT_EQ(1, calls);
}

TEST(ReferenceTest, ThePathMayBeChangedWhileItIsEnumerated)
{
    TCIMReference path = Path("C");
    path.AddKeyValue("a", TCIMValue(1));
    path.AddKeyValue("b", TCIMValue(2));
    std::string names;
    path.EnumerateKeyBindings([&](const std::pair<std::string, TCIMValue>& binding) {
        names += binding.first;
        path = TCIMReference();
        return true;
    });
    EXPECT_EQ("ab", names);
}

TEST(ReferenceTest, AClassThatNobodyDeclaredIsAStub)
{
    TCIMReference path = Path("Disk");
    ASSERT_NE(nullptr, path.GetClass());
    EXPECT_EQ("Disk", path.GetClass()->GetName(TCallContext()));
    path.SetClassName("");
    EXPECT_EQ(nullptr, path.GetClass());
    const auto cls = boost::make_shared<TStubClass>("Drive");
    path.SetClass(cls);
    EXPECT_EQ(cls, path.GetClass());
    EXPECT_EQ("Drive", path.GetPath());
    path.SetClass(nullptr);
    EXPECT_EQ("", path.GetPath());
}

TEST(ReferenceTest, TextReadComesBackTheSame)
{
    for (const char* const text :
         {"Disk", "Disk.Id=\"sda\"", "root/cimv2:Disk", "root/cimv2:Disk.Bay=5,Id=\"sda\"", "//web01/root/cimv2:Disk.Id=\"sda\"",
          "//web01:5989/root/cimv2:Disk.Id=\"sda\"", "C.a=TRUE,b=FALSE,c=NULL", "C.a=-5,b=18446744073709551615,c=0.1,d=1e+300",
          "C.a='x',b='\\'',c='\\\\'", "C.a=\"\",b=\"\\\"\\\\\",c=\"a,b=c.d:e\"", "C.a=INF,b=-INF,c=NaN", "//web01/Disk", ".Id=1",
          "root:.Id=1", "L.P=\"root/cimv2:D.I=\\\"x\\\"\"", "root/a.b:C.K=\"x:y\"", "C.K=\"x:y\""}) {
        EXPECT_EQ(text, TCIMReference::Parse(text).GetPath());
    }
}

TEST(ReferenceTest, OtherFormsOfAPathAreUnderstood)
{
    const std::pair<const char*, const char*> cases[] = {
        {"/root/cimv2:Disk.Id=\"sda\"", "root/cimv2:Disk.Id=\"sda\""},
        {"Disk.id=1,Bay=2", "Disk.Bay=2,id=1"},
        {"Disk=@", "Disk"},
        {"C.a=true,b=False,c=null", "C.a=TRUE,b=FALSE,c=NULL"},
        {"C.a=+5,b=0x1F,c=-0x1f", "C.a=5,b=31,c=-31"},
        {"C.a=\"\\a\\b\"", "C.a=\"ab\""},
        {":Disk", "Disk"},
        {"/Disk", "Disk"},
    };
    for (const auto& [text, path] : cases) {
        EXPECT_EQ(path, TCIMReference::Parse(text).GetPath()) << text;
    }
}

TEST(ReferenceTest, ValuesReadGetTheTypesOfTheirText)
{
    EXPECT_EQ("a=5:8 b=5:9 c=-5:9 d=5:11 e=5:13 f=5:12 g=TRUE:1 h=NULL:0 i=123456789012345683968:11 ",
              BindingsOf(TCIMReference::Parse("C.a=5,b=+5,c=-5,d=5.0,e=\"5\",f='5',g=TRUE,h=NULL,i=123456789012345680000")));
}

TEST(ReferenceTest, WhatIsNoPathIsRefusedAtItsPosition)
{
    const std::pair<const char*, std::size_t> cases[] = {
        {"", 0},
        {"5Disk", 0},
        {"Disk.", 5},
        {"Disk.Id", 7},
        {"Disk.Id=", 8},
        {"Disk.Id=\"a", 10},
        {"Disk.Id=\"a\\", 11},
        {"Disk.Id=\"a\"x", 11},
        {"Disk.Id=1,", 10},
        {"Disk.Id=1,Id=2", 10},
        {"Disk.=1", 5},
        {"Disk Drive", 4},
        {"root:", 5},
        {"//", 2},
        {"//web01", 2},
        {"///root:Disk", 2},
        {"Disk.Id=abc", 8},
        {"Disk.Id='ab'", 8},
        {"Disk.Id=''", 8},
        {"Disk.a=1,A=2", 9},
        {"Disk.Id=1 2", 8},
        {"Disk=", 4},
        {"Disk.Id=0x", 8},
        {"=@", 0},
    };
    for (const auto& [text, position] : cases) {
        std::size_t found = 99;
        EXPECT_EQ(kParseError, StatusOf([&] { TCIMReference::Parse(text, nullptr, &found); })) << text;
        EXPECT_EQ(position, found) << text;
    }
}

TEST(ReferenceTest, APathOfManyKeysOrEscapesIsReadWhole)
{
    std::string keys = "C.";
    for (int i = 60000; i > 0; --i) {
        keys += "K" + std::to_string(i) + "=1" + (i > 1 ? "," : "");
    }
    EXPECT_EQ(60000u, TCIMReference::Parse(keys).GetKeyCount());
    const std::string quotes = "C.K=\"" + std::string(2000000, '\\') + "\"";
    EXPECT_EQ(1000000u, TCIMReference::Parse(quotes).FindKeyValue("K")->GetString().size());
}

}  // namespace
}  // namespace NORVZEL20
