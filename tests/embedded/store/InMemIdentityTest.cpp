// The store and the text of paths have one idea of which instances are the same.

#include <cmath>

#include "embedded/value/TEmbeddedObject.h"
#include "host/TCIMDateTime.h"
#include "tests/embedded/store/TInMemFixture.h"

namespace NORVZEL20 {
namespace {

class InMemIdentityTest : public TInMemFixture {
  protected:
    static TCIMValue At(const char* text)
    {
        TCIMDateTime time;
        EXPECT_TRUE(TCIMDateTime::Parse(text, time)) << text;
        return TCIMValue(time);
    }

    static TCIMValue Setting(const char* className, const std::vector<std::pair<std::string, TCIMValue>>& values)
    {
        const auto object = boost::make_shared<TEmbeddedObject>(className);
        for (const auto& [name, value] : values) {
            object->AddProperty({name, value, "", 0, "", false, {}});
        }
        return TCIMValue(boost::shared_ptr<const TEmbeddedObject>(object));
    }

    TCIMValue PathTo(const std::string& text) const { return TCIMValue(Path(text)); }

    std::string PathOf(const TInstancePointer& instance) const
    {
        TCIMReference path = instance->GetReference();
        path.SetNamespaceName("");
        return path.GetPath();
    }

    /// A class whose key has that type, with an instance for each value, or "twice" if it is refused.
    std::string AddAll(TType::ECIMType type, const std::vector<TCIMValue>& keys)
    {
        const std::string name = "C" + std::to_string(++fClasses);
        const auto cls = Declare(name, nullptr, {{"Key", type, {"Key"}}});
        std::string paths;
        for (const TCIMValue& key : keys) {
            const auto instance = Allocate(cls, {{"Key", key}});
            const int status = StatusOf([&] { instance->AddToNamespace(kNoContext); });
            EXPECT_TRUE(status == 0 || status == TZELStatusCode::kAlreadyExists) << status;
            paths += (status == 0 ? PathOf(instance).substr(name.size() + 5) : "twice") + "\n";
            TCIMReference path;
            path.SetClassName(name);
            path.AddKeyValue("Key", key);
            EXPECT_NE(nullptr, fNamespace->FindInstance(path)) << path.GetPath();
            EXPECT_EQ(PathOf(instance), PathOf(fNamespace->FindInstance(path))) << "what is found has the text of the path";
            EXPECT_EQ(fNamespace->FindInstance(path), fNamespace->FindInstance(TCIMReference::Parse(path.GetPath())));
        }
        return paths;
    }

  private:
    int fClasses = 0;
};

TEST_F(InMemIdentityTest, DatetimesAreTheSameKeyAtAnyOffset)
{
    EXPECT_EQ(
        "\"20240229110000.000000+000\"\ntwice\ntwice\n\"20240229120000.000000+000\"\n\"00000001000000.000000:000\"\n",
        AddAll(TType::kDateTime, {At("20240229120000.000000+060"), At("20240229110000.000000+000"), At("20240229120000.000000+060"),
                                  At("20240229120000.000000+000"), At("00000001000000.000000:000")}));
    EXPECT_EQ("\"2024022911****.******+000\"\ntwice\n\"20240229******.******+060\"\n\"20240229******.******+000\"\n",
              AddAll(TType::kDateTime, {At("2024022912****.******+060"), At("2024022911****.******+000"),
                                        At("20240229******.******+060"), At("20240229******.******+000")}));
}

TEST_F(InMemIdentityTest, EmbeddedObjectsAreTheSameKeyInAnyOrderAndSpelling)
{
    const std::string text =
        "\"<INSTANCE CLASSNAME=\\\"setting\\\"><PROPERTY NAME=\\\"a\\\" TYPE=\\\"sint32\\\"><VALUE>1</VALUE></PROPERTY>"
        "<PROPERTY NAME=\\\"b\\\" TYPE=\\\"string\\\"><VALUE>x</VALUE></PROPERTY></INSTANCE>\"\n";
    EXPECT_EQ(text + "twice\n\"<INSTANCE CLASSNAME=\\\"setting\\\"></INSTANCE>\"\ntwice\n\"plain\"\n",
              AddAll(TType::kString, {Setting("Setting", {{"A", TCIMValue(1)}, {"B", TCIMValue("x")}}),
                                      Setting("SETTING", {{"b", TCIMValue("x")}, {"a", TCIMValue(1)}}), Setting("Setting", {}),
                                      TCIMValue("<INSTANCE CLASSNAME=\"setting\"></INSTANCE>"), TCIMValue("plain")}));
}

TEST_F(InMemIdentityTest, ReferencesAreTheSameKeyInAnyLetterCaseOfTheirPlace)
{
    EXPECT_EQ("\"//web01/root/hw:Disk.Id=1\"\ntwice\n\"root/hw:Disk.Id=1\"\n\"Disk.Id=1\"\n",
              AddAll(TType::kReference, {PathTo("//web01/root/hw:Disk.Id=1"), PathTo("//WEB01/ROOT/hw:Disk.Id=1"),
                                         PathTo("root/HW:Disk.Id=1"), PathTo("Disk.Id=1")}));
}

TEST_F(InMemIdentityTest, NumbersTextsAndTheRestAreTheSameKeyIfEqual)
{
    EXPECT_EQ("0\ntwice\n0.5\nNaN\ntwice\n", AddAll(TType::kReal64, {TCIMValue(-0.0), TCIMValue(0.0), TCIMValue(0.5),
                                                                     TCIMValue(std::nan("")), TCIMValue(-std::nan(""))}));
    EXPECT_EQ("0.1\ntwice\n0\ntwice\n",
              AddAll(TType::kReal32, {TCIMValue(0.1f), TCIMValue(0.1f), TCIMValue(0.0f), TCIMValue(-0.0f)}));
    EXPECT_EQ("-128\n127\ntwice\n",
              AddAll(TType::kSint8, {TCIMValue(static_cast<signed char>(-128)), TCIMValue(static_cast<signed char>(127)),
                                     TCIMValue(static_cast<signed char>(127))}));
    EXPECT_EQ("18446744073709551615\ntwice\n", AddAll(TType::kUint64, {Uint64(~std::uint64_t{0}), Uint64(~std::uint64_t{0})}));
    EXPECT_EQ("TRUE\nFALSE\ntwice\n", AddAll(TType::kBoolean, {TCIMValue(true), TCIMValue(false), TCIMValue(true)}));
    EXPECT_EQ("'x'\n'X'\ntwice\n", AddAll(TType::kChar16, {TCIMValue(u'x'), TCIMValue(u'X'), TCIMValue(u'x')}));
    EXPECT_EQ("\"a\"\n\"A\"\ntwice\n", AddAll(TType::kString, {TCIMValue("a"), TCIMValue("A"), TCIMValue("a")}));
}

TEST_F(InMemIdentityTest, APathReadWithItsNamespaceHasTheTextOfTheInstance)
{
    const auto event = Declare("Event", nullptr, {{"When", TType::kDateTime, {"Key"}}, {"Load", TType::kReal32, {"Key"}}});
    const auto instance = Add(event, {{"When", At("20240229120000.000000+060")}, {"Load", TCIMValue(-0.0f)}});
    Declare("Link", nullptr, {{"On", TType::kReference, {"Key"}}, {"Size", TType::kUint8, {}}});
    EXPECT_EQ("root/cimv2:Event.Load=0,When=\"20240229110000.000000+000\"", instance->GetReference().GetPath());
    const std::pair<const char*, const char*> cases[] = {
        {"event.WHEN=\"20240229120000.000000+060\",load=-0.0", "Event.Load=0,When=\"20240229110000.000000+000\""},
        {"/ROOT/cimv2:Event.When=\"20240229110000.000000+000\",Load=0",
         "root/cimv2:Event.Load=0,When=\"20240229110000.000000+000\""},
        {"//WEB01/root/cimv2:Event.When=\"never\",Load=0.5", "//web01/root/cimv2:Event.Load=0.5,When=\"never\""},
        {"Link.on=\"/ROOT/a:event.When=\\\"20240229120000.000000+060\\\",load=0\"",
         "Link.On=\"root/a:Event.Load=0,When=\\\"20240229110000.000000+000\\\"\""},
        {"Link.On=\"no path\"", "Link.On=\"no path\""},
        {"Link.Size=256,Other=\"x\"", "Link.Other=\"x\",Size=256"},
        {"Nobody.When=\"20240229120000.000000+060\"", "Nobody.When=\"20240229120000.000000+060\""},
    };
    for (const auto& [text, path] : cases) {
        EXPECT_EQ(path, Path(text).GetPath()) << text;
    }
    EXPECT_EQ(instance, fNamespace->FindInstance(Path("event.WHEN=\"20240229033000.000000-450\",load=0")));
}

TEST_F(InMemIdentityTest, PathsTooDeepForAReferenceStayText)
{
    Declare("Link", nullptr, {{"On", TType::kReference, {"Key"}}});
    TCIMReference path;
    for (int depth = 0; depth < 14; ++depth) {
        const std::string inner = path.GetPath();
        path = TCIMReference();
        path.SetClassName("Link");
        path.AddKeyValue("On", TCIMValue(inner));
    }
    const TCIMReference read = Path(path.GetPath());
    EXPECT_EQ(path.GetPath(), read.GetPath());
    EXPECT_EQ(TType::kString, read.FindKeyValue("On")->GetType());
}

}  // namespace
}  // namespace NORVZEL20
