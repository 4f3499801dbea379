#include <stdexcept>

#include "embedded/store/TKeyTexts.h"
#include "embedded/value/TEmbeddedObject.h"
#include "tests/embedded/store/TInMemFixture.h"

namespace NORVZEL20 {
namespace {

/// Disks, and parts that refer to them in every way.
class KeyTextsTest : public TInMemFixture {
  protected:
    TCIMValue To(const std::string& disk) const { return TCIMValue(Path("Disk.Id=\"" + disk + "\"")); }

    static TCIMValue Holder(const TCIMValue& reference)
    {
        const auto object = boost::make_shared<TEmbeddedObject>("Cfg", false);
        TEmbeddedObject::TProperty property;
        property.name = "On";
        property.value = reference;
        object->AddProperty(property);
        return TCIMValue(boost::shared_ptr<const TEmbeddedObject>(object));
    }

    /// Writes `now` in the place of `before`.
    std::string Rename(const std::string& before, const std::string& now)
    {
        return TKeyTexts(*fNamespace).Change([&](std::string_view text, const TKeyTexts::TPlace& place) {
            fPlaces += std::string(place.className) + "." + std::string(place.key) +
                       (place.isInReference ? " of a reference: " : ": ") + std::string(text) + "\n";
            return text == before ? TCIMValue::FromText(now) : TCIMValue();
        });
    }

    TClassPointer fDisk = DeclareDisk();
    TClassPointer fPart = Declare("Part", nullptr,
                                  {{"Dev", TType::kReference, {"Key"}},
                                   {"Number", TType::kUint64, {"Key"}},
                                   {"Others", TType::kArrayReference, {}},
                                   {"Cfg", TType::kString, {}}});
    TClassPointer fOwner = Declare("Owner", nullptr, {{"Of", TType::kReference, {"Key"}}});
    std::string fPlaces;
};

TEST_F(KeyTextsTest, KeysAndReferencesChangeTogetherAndTheOrderStays)
{
    Add(fDisk, {{"Id", "sda"}, {"Label", "sda"}});
    Add(fDisk, {{"Id", "sdb"}, {"Label", "x"}});
    const TCIMValue others(TType::kArrayReference, 2, {To("sda"), To("sdb")});
    const TInstancePointer part =
        Add(fPart, {{"Dev", To("sda")}, {"Number", Uint64(1)}, {"Others", others}, {"Cfg", Holder(To("sda"))}});
    Add(fOwner, {{"Of", TCIMValue(part->GetReference())}});
    EXPECT_EQ("", Rename("sda", "nvme0"));
    EXPECT_EQ("Disk.Id=\"nvme0\"\nDisk.Id=\"sdb\"\n", InstancesOf(*fDisk));
    EXPECT_EQ("Part.Dev=\"Disk.Id=\\\"nvme0\\\"\",Number=1\n", InstancesOf(*fPart));
    EXPECT_EQ("nvme0 is the key, sda a label",
              std::string(fNamespace->FindInstance(Path("Disk.Id=\"nvme0\""))->FindProperty("Id")->GetValue().GetString()) +
                  " is the key, " +
                  std::string(fNamespace->FindInstance(Path("Disk.Id=\"nvme0\""))->FindProperty("Label")->GetValue().GetString()) +
                  " a label");
    EXPECT_EQ(nullptr, fNamespace->FindInstance(Path("Disk.Id=\"sda\"")));
    const std::string values = ValuesOf(*part);
    EXPECT_EQ(std::string::npos, values.find("sda")) << values;
    EXPECT_EQ(std::string::npos, InstancesOf(*fOwner).find("sda")) << InstancesOf(*fOwner);
}

TEST_F(KeyTextsTest, EachTextIsAskedAboutWithItsPlace)
{
    Add(fDisk, {{"Id", "sda"}, {"Label", "a label"}});
    Add(fPart, {{"Dev", To("sda")}, {"Number", Uint64(1)}});
    EXPECT_EQ("", Rename("none", "other"));
    EXPECT_EQ("Disk.Id: sda\nPart.Id of a reference: sda\n", fPlaces);
}

TEST_F(KeyTextsTest, TwoInstancesThatWouldFallTogetherStay)
{
    Add(fDisk, {{"Id", "sda"}});
    Add(fDisk, {{"Id", "sdb"}});
    Add(fPart, {{"Dev", To("sda")}, {"Number", Uint64(1)}});
    const std::string before = InstancesOf(*fDisk) + InstancesOf(*fPart);
    EXPECT_EQ("root/cimv2:Disk.Id=\"sdb\"", Rename("sda", "sdb"));
    EXPECT_EQ(before, InstancesOf(*fDisk) + InstancesOf(*fPart));
    EXPECT_NE(nullptr, fNamespace->FindInstance(Path("Disk.Id=\"sda\"")));
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, StatusOf([&] { Add(fDisk, {{"Id", "sda"}}); }));
}

TEST_F(KeyTextsTest, AnErrorLeavesEverythingAsItWas)
{
    Add(fDisk, {{"Id", "sda"}});
    Add(fPart, {{"Dev", To("sda")}, {"Number", Uint64(1)}});
    const std::string before = InstancesOf(*fDisk) + InstancesOf(*fPart);
    EXPECT_THROW(TKeyTexts(*fNamespace).Change([](std::string_view, const TKeyTexts::TPlace& place) {
        if (place.isInReference) {
            throw std::runtime_error("stop");
        }
        return TCIMValue("other");
    }),
                 std::runtime_error);
    EXPECT_EQ(before, InstancesOf(*fDisk) + InstancesOf(*fPart));
    EXPECT_NE(nullptr, fNamespace->FindInstance(Path("Disk.Id=\"sda\"")));
}

TEST_F(KeyTextsTest, NamesMaySwap)
{
    Add(fDisk, {{"Id", "sda"}, {"Size", Uint64(1)}});
    Add(fDisk, {{"Id", "sdb"}, {"Size", Uint64(2)}});
    EXPECT_EQ("", TKeyTexts(*fNamespace).Change([](std::string_view text, const TKeyTexts::TPlace&) {
        return TCIMValue::FromText(text == "sda" ? "sdb" : "sda");
    }));
    EXPECT_EQ("Disk.Id=\"sdb\"\nDisk.Id=\"sda\"\n", InstancesOf(*fDisk));
    EXPECT_EQ(2U, fNamespace->FindInstance(Path("Disk.Id=\"sda\""))->FindProperty("Size")->GetValue().GetUnsigned());
}

}  // namespace
}  // namespace NORVZEL20
