#include "embedded/store/TLikelySlots.h"

#include <iterator>
#include <sstream>
#include <string>
#include <vector>

#include "tests/embedded/store/TDevicesFixture.h"

namespace NORVZEL20 {
namespace {

TEST(LikelySlots, ASlotIsGuessedInAnyLetterCase)
{
    TLikelySlots slots;
    EXPECT_EQ(TLikelySlots::kNone, slots.Guess("Size"));
    slots.Add("Size", 3);
    EXPECT_EQ(3u, slots.Guess("Size"));
    EXPECT_EQ(3u, slots.Guess("sIZE"));
    slots.Remove("SIZE", 3);
    EXPECT_EQ(TLikelySlots::kNone, slots.Guess("Size"));
}

// The two have the same first entry, and others after it.
TEST(LikelySlots, ANameWhoseEntryIsTakenIsGuessedAgain)
{
    TLikelySlots slots;
    slots.Add("State", 1);
    slots.Add("Ratio", 2);
    EXPECT_EQ(1u, slots.Guess("Ratio"));
    EXPECT_EQ(2u, slots.GuessAgain("Ratio"));
    EXPECT_EQ(2u, slots.GuessAgain("rATIO"));
    EXPECT_EQ(1u, slots.Guess("State"));
    EXPECT_EQ(TLikelySlots::kNone, slots.GuessAgain("State"));
    slots.Remove("Ratio", 2);
    EXPECT_EQ(TLikelySlots::kNone, slots.GuessAgain("Ratio"));
    EXPECT_EQ(1u, slots.Guess("State"));
}

TEST(LikelySlots, NearlyAllNamesOfALargeClassAreGuessed)
{
    std::istringstream text(
        "InstanceID Caption Description ElementName InstallDate Name OperationalStatus StatusDescriptions Status "
        "HealthState CommunicationStatus DetailedStatus OperatingStatus PrimaryStatus EnabledState OtherEnabledState "
        "RequestedState EnabledDefault TimeOfLastStateChange AvailableRequestedStates TransitioningToState "
        "SystemCreationClassName SystemName CreationClassName DeviceID PowerManagementSupported "
        "PowerManagementCapabilities Availability StatusInfo LastErrorCode ErrorDescription ErrorCleared "
        "OtherIdentifyingInfo PowerOnHours TotalPowerOnHours IdentifyingDescriptions AdditionalAvailability "
        "MaxQuiesceTime DataOrganization Purpose");
    const std::vector<std::string> names{std::istream_iterator<std::string>(text), std::istream_iterator<std::string>()};
    TLikelySlots slots;
    for (std::uint32_t slot = 0; slot < names.size(); ++slot) {
        slots.Add(names[slot], slot);
    }
    std::size_t guessed = 0;
    for (std::uint32_t slot = 0; slot < names.size(); ++slot) {
        guessed += slots.Guess(names[slot]) == slot || slots.GuessAgain(names[slot]) == slot ? 1 : 0;
    }
    EXPECT_LE(names.size() * 9 / 10, guessed);
}

TEST(LikelySlots, ASlotThatNeedsMoreThanAByteIsNotGuessed)
{
    TLikelySlots slots;
    slots.Add("Size", 254);
    slots.Add("Size", 255);
    EXPECT_EQ(254u, slots.Guess("Size"));
}

TEST(LikelySlots, TheEmptyNameIsAName)
{
    TLikelySlots slots;
    slots.Add("", 0);
    EXPECT_EQ(0u, slots.Guess(""));
}

class SlotLookUpTest : public TDevicesFixture {
  protected:
    static std::string SlotsOf(const TInMemClass& cls, std::initializer_list<const char*> names)
    {
        std::string text;
        for (const char* const name : names) {
            const std::uint32_t slot = cls.GetLayout().FindSlot(name);
            text += (text.empty() ? "" : " ") + (slot == TInMemLayout::kNoSlot ? "-" : std::to_string(slot));
        }
        return text;
    }
};

TEST_F(SlotLookUpTest, ARemovedPropertyIsNotFoundUntilItIsAddedAgain)
{
    EXPECT_EQ("1 1", SlotsOf(*fDisk, {"Size", "size"}));
    fDisk->RemovePropertyDecl(fDisk->GetPropertyDecl("Size", kNoContext));
    EXPECT_EQ("- -", SlotsOf(*fDisk, {"Size", "size"}));
    EXPECT_EQ("- -", SlotsOf(*fSolidState, {"Size", "size"}));
    fDisk->AddPropertyDecl(Decl({"SIZE", TType::kUint64, {}}));
    EXPECT_EQ("2 2 2", SlotsOf(*fDisk, {"Size", "size", "SIZE"}));
    EXPECT_EQ("3 3 3", SlotsOf(*fSolidState, {"Size", "size", "SIZE"}));
}

TEST_F(SlotLookUpTest, AnOverrideInAnotherSpellingIsFoundInBoth)
{
    fSolidState->AddPropertyDecl(Decl({"SIZE", TType::kUint64, {}}));
    EXPECT_EQ("1 1 1", SlotsOf(*fSolidState, {"Size", "SIZE", "sIzE"}));
    EXPECT_EQ("1 1 1", SlotsOf(*fDisk, {"Size", "SIZE", "sIzE"}));
    fSolidState->RemovePropertyDecl(fSolidState->GetPropertyDecl("SIZE", kNoContext));
    EXPECT_EQ("1 1 1", SlotsOf(*fSolidState, {"Size", "SIZE", "sIzE"}));
}

TEST_F(SlotLookUpTest, EachOfManyPropertiesIsFound)
{
    const auto cls = Allocate("Wide", nullptr);
    for (int number = 0; number < 600; ++number) {
        cls->AddPropertyDecl(Decl({"Property" + std::to_string(number), TType::kUint8, {}}));
    }
    for (std::uint32_t number = 0; number < 600; ++number) {
        EXPECT_EQ(number, cls->GetLayout().FindSlot("Property" + std::to_string(number)));
        EXPECT_EQ(number, cls->GetLayout().FindSlot("pROPERTY" + std::to_string(number)));
    }
    EXPECT_EQ(TInMemLayout::kNoSlot, cls->GetLayout().FindSlot("Property600"));
}

}  // namespace
}  // namespace NORVZEL20
