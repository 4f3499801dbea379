// What a command allocates grows in proportion to what it is given. In a program of its own, which counts calls of operator new.

#include "tests/client/Documents.h"
#include "tests/client/TClientFixture.h"
#include "tests/embedded/store/CountedAllocations.h"

namespace NORVZEL20 {
namespace {

class GrowthTest : public TClientFixture {
  protected:
    /// How many times as many allocations 2n things take as n things.
    template <class TRunWith>
    static double Factor(std::size_t n, TRunWith runWith)
    {
        runWith(n);  // what is made once for the process
        const std::size_t once = runWith(n);
        return static_cast<double>(runWith(2 * n)) / static_cast<double>(once);
    }

    /// Runs a command that must succeed. Returns the number of allocations.
    std::size_t Allocations(const std::vector<std::string>& arguments)
    {
        const std::size_t before = CountedAllocations();
        Run(arguments);
        EXPECT_NE(2, fStatus) << fErr;
        return CountedAllocations() - before;
    }

    std::string Inventory(const std::string& name, const std::string& contents)
    {
        return Scratch(name, Document(System() + contents));
    }

    std::string Rules(const std::string& elements) { return Scratch("rules", "<DifftoolSpec>" + elements + "</DifftoolSpec>"); }

    static std::string Number(std::size_t i) { return std::to_string(1000 + i); }
};

const double kInProportion = 2.2;

TEST_F(GrowthTest, ExplainingAClassWithTheNumberOfListedProperties)
{
    EXPECT_LE(Factor(200,
                     [this](std::size_t n) {
                         std::string properties = KeyProperty("Id");
                         std::string listed;
                         for (std::size_t i = 0; i < n; ++i) {
                             properties += Declaration("P" + Number(i), "string");
                             listed += "<value>P" + Number(i) + "</value>";
                         }
                         const std::string rules = Rules("<class name='Disk'><includelist>" + listed + "</includelist></class>");
                         return Allocations(
                             {"explain", "Disk", "--spec", rules, "--schema", Inventory("a.xml", Class("Disk", "", properties))});
                     }),
              kInProportion);
}

TEST_F(GrowthTest, CheckingElementsThatExcludeKeysOfTheirOwn)
{
    EXPECT_LE(Factor(300,
                     [this](std::size_t n) {
                         std::string classes;
                         std::string elements;
                         for (std::size_t i = 0; i < n; ++i) {
                             const std::string key = "Id" + Number(i);
                             classes += Class("C" + Number(i), "", KeyProperty(key) + "<PROPERTY.REFERENCE NAME='At'/>");
                             elements += "<class name='C" + Number(i) + "' default='include' excludekeys='" + key + "'/>";
                         }
                         return Allocations({"check", Rules(elements), "--schema", Inventory("a.xml", classes)});
                     }),
              kInProportion);
}

TEST_F(GrowthTest, ComparingInventories)
{
    EXPECT_LE(Factor(20,
                     [this](std::size_t n) {
                         std::string classes;
                         for (std::size_t i = 0; i < 20; ++i) {
                             classes += Class("C" + Number(i), "", KeyProperty("Id") + Declaration("Size", "string"));
                         }
                         std::vector<std::string> arguments{"compare", "--detail"};
                         for (std::size_t i = 0; i < n; ++i) {
                             arguments.push_back(Inventory(Number(i) + ".xml", classes));
                         }
                         return Allocations(arguments);
                     }),
              kInProportion);
}

TEST_F(GrowthTest, ComparingInstancesThatShareAKey)
{
    EXPECT_LE(Factor(200,
                     [this](std::size_t n) {
                         const std::string cls = Class("Disk", "", KeyProperty("Id") + Declaration("Size", "string"));
                         std::string disks;
                         for (std::size_t i = 0; i < n; ++i) {
                             disks += Instance("Disk", Value("Id", Number(i)) + Value("Size", Number(i)));
                         }
                         return Allocations(
                             {"compare", "--detail", "--spec", Rules("<class name='Disk' default='include' excludekeys='Id'/>"),
                              Inventory("a.xml", cls + Instance("Disk", Value("Id", "x"))), Inventory("b.xml", cls + disks)});
                     }),
              kInProportion);
}

}  // namespace
}  // namespace NORVZEL20
