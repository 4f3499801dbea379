#include "embedded/query/TQuery.h"

#include <string>
#include <vector>

#include "embedded/value/TEmbeddedObject.h"
#include "tests/embedded/store/TInMemFixture.h"
#include "tests/embedded/value/DateTimeOf.h"

namespace NORVZEL20 {
namespace {

class QueryTest : public TInMemFixture {
  protected:
    QueryTest()
    {
        fDevice = Declare("Device", nullptr,
                          {{"Id", TType::kString, {"Key"}},
                           {"Big", TType::kUint64, {}},
                           {"Small", TType::kSint8, {}},
                           {"Share", TType::kReal64, {}},
                           {"On", TType::kBoolean, {}},
                           {"Since", TType::kDateTime, {}},
                           {"Grade", TType::kChar16, {}},
                           {"Next", TType::kReference, {}},
                           {"Part", TType::kString, {}},
                           {"Tags", TType::kArrayString, {}}});
        fDisk = Declare("Disk", fDevice, {{"Label", TType::kString, {}}});
        Add(fDevice, {{"Id", "cpu"},
                      {"Big", TCIMValue(~static_cast<std::uint64_t>(0))},
                      {"Small", TCIMValue(static_cast<signed char>(-5))},
                      {"Share", TCIMValue(0.5)},
                      {"On", TCIMValue(true)},
                      {"Grade", TCIMValue(u'b')}});
        const auto fan = Add(fDevice, {{"Id", "fan"},
                                       {"Big", TCIMValue(static_cast<std::uint64_t>(3))},
                                       {"On", TCIMValue(false)},
                                       {"Since", TCIMValue(DateTimeOf("20200102030405.000000+060"))}});
        Add(fDisk, {{"Id", "sda"},
                    {"Label", "a\"b'c\\d"},
                    {"Big", TCIMValue(static_cast<std::uint64_t>(3))},
                    {"Share", TCIMValue(3.0)},
                    {"Next", TCIMValue(fan->GetReference())},
                    {"Tags", Texts({"x"})},
                    {"Since", TCIMValue(DateTimeOf("2020010203****.******+060"))}});
        Add(fDisk, {{"Id", "sdb"}, {"Part", TCIMValue(boost::make_shared<const TEmbeddedObject>("Disk"))}});
    }

    /// The ids of the answers, with blanks between.
    std::string Answer(std::string query, std::string language = "WQL")
    {
        std::string ids;
        fNamespace->ExecuteQuery(
            [&](boost::shared_ptr<ICIMInstance> instance) {
                ids += (ids.empty() ? "" : " ") + instance->GetProperty("Id", kNoContext)->GetValue(kNoContext).ToText();
                return true;
            },
            language, query, kNoContext);
        return ids;
    }

    std::string Where(const std::string& condition) { return Answer("SELECT * FROM Device WHERE " + condition); }

    struct TConditionRow {
        const char* condition;
        const char* ids;
    };

    void ExpectAnswers(const std::vector<TConditionRow>& rows)
    {
        for (const TConditionRow& row : rows) {
            EXPECT_EQ(row.ids, Where(row.condition)) << row.condition;
        }
    }

    TClassPointer fDevice, fDisk;
};

TEST_F(QueryTest, CoversTheClassAndAllBelow)
{
    EXPECT_EQ("cpu fan sda sdb", Answer("SELECT * FROM Device"));
    EXPECT_EQ("sda sdb", Answer("select * from DISK"));
    EXPECT_EQ("sda sdb", Answer("\tselect\r\n*\nfrom disk ", "wql"));
    EXPECT_EQ("sda sdb", Answer("SELECT Id, disk.Label FROM Disk", "DMTF:CQL"));
    EXPECT_EQ("cpu fan sda sdb", Answer("SELECT Label FROM Device"));
    EXPECT_EQ("sda sdb", Answer("SELECT Disk.* FROM Disk"));
}

TEST_F(QueryTest, StopsWhenTheCallbackReturnsFalse)
{
    int answers = 0;
    TQuery("WQL", "SELECT * FROM Device").Execute(*fNamespace, [&](boost::shared_ptr<ICIMInstance>) { return ++answers < 3; });
    EXPECT_EQ(3, answers);
}

TEST_F(QueryTest, TextsCompareAsTheyAreWritten)
{
    ExpectAnswers({
        {"Id = 'sda'", "sda"},
        {"ID = \"sda\"", "sda"},
        {"Id = 'SDA'", ""},
        {"'sda' = Id", "sda"},
        {"Id <> 'sda'", "cpu fan sdb"},
        {"Id != 'sda'", "cpu fan sdb"},
        {"Id < 'sda'", "cpu fan"},
        {"Id <= 'sda'", "cpu fan sda"},
        {"Id > 'fan'", "sda sdb"},
        {"Id >= 'fan'", "fan sda sdb"},
        {"Device.Id = 'fan'", "fan"},
        {"Label = 'a\\\"b\\'c\\\\d'", "sda"},
        {"Label = \"a\\\"b'c\\\\d\"", "sda"},
    });
}

TEST_F(QueryTest, NumbersCompareByTheirValue)
{
    ExpectAnswers({
        {"Big = 3", "fan sda"},
        {"Big = 3.0", "fan sda"},
        {"Big = 0x3", "fan sda"},
        {"Big > -1", "cpu fan sda"},
        {"Big = 18446744073709551615", "cpu"},
        {"Big = 18446744073709551614", ""},
        {"Big = 1.8446744073709551616e19", ""},
        {"Small = -5", "cpu"},
        {"Small < 0", "cpu"},
        {"Share < 1", "cpu"},
        {"Share = .5", "cpu"},
        {"Share >= 5e-1", "cpu sda"},
        {"Big = Share", "sda"},
        {"Big > Small", "cpu"},
    });
}

TEST_F(QueryTest, OtherValuesCompareIfTheyHaveAnOrder)
{
    ExpectAnswers({
        {"On = TRUE", "cpu"},
        {"On <> true", "fan"},
        {"On = FALSE", "fan"},
        {"Since = '20200102020405.000000+000'", "fan"},
        {"Since < '20200102020405.000001+000'", "fan"},
        {"Since <> '20200102020405.000000+000'", ""},
        {"Grade = 'b'", "cpu"},
        {"Grade > 'a'", "cpu"},
        {"Next = 'root/cimv2:Device.Id=\"fan\"'", "sda"},
        {"Next <> 'x'", "sda"},
    });
}

TEST_F(QueryTest, NullIsNeitherEqualNorUnequal)
{
    ExpectAnswers({
        {"Big IS NULL", "sdb"},
        {"Big is not null", "cpu fan sda"},
        {"Tags IS NOT NULL", "sda"},
        {"Label IS NULL", "cpu fan sdb"},
        {"Big = NULL", ""},
        {"NOT Big = NULL", ""},
        {"NULL IS NULL", "cpu fan sda sdb"},
        {"NOT Big = 3", "cpu"},
        {"NOT NOT Big = 3", "fan sda"},
        {"NOT (Big = 3 OR On = TRUE)", ""},
        {"Big = 3 AND Share = 3 OR Id = 'cpu'", "cpu sda"},
        {"Big = 3 AND (Share = 3 OR Id = 'fan')", "fan sda"},
    });
}

TEST_F(QueryTest, PatternsAndClassesHaveTheirAnswers)
{
    ExpectAnswers({
        {"Id LIKE 'sd%'", "sda sdb"},
        {"Id LIKE 'sd[^a]'", "sdb"},
        {"NOT Id LIKE '%a%'", "cpu sdb"},
        {"Label LIKE '%'", "sda"},
        {"Part LIKE '%'", ""},
        {"Part = 'x' OR Part <> 'x'", ""},
        {"Device ISA Disk", "sda sdb"},
        {"device isa 'DEVICE'", "cpu fan sda sdb"},
        {"NOT Device ISA Disk", "cpu fan"},
        {"Part ISA Device", "sdb"},
        {"Part ISA 'Fan'", ""},
        {"Next ISA Device", "sda"},
        {"Next ISA Disk", ""},
        {"1 = 1", "cpu fan sda sdb"},
        {"'a' = 'b'", ""},
    });
}

TEST_F(QueryTest, ALongConditionIsNotADeepOne)
{
    std::string condition = "Id = 'sda'";
    for (int number = 0; number < 10000; ++number) {
        condition += " OR Id = 'x'";
    }
    EXPECT_EQ("sda", Where(condition));
}

TEST_F(QueryTest, AnInstanceAddedByTheCallbackIsNoAnswer)
{
    int answers = 0;
    TQuery("WQL", "SELECT * FROM Disk").Execute(*fNamespace, [&](boost::shared_ptr<ICIMInstance>) {
        Add(fDisk, {{"Id", TCIMValue("new" + std::to_string(answers))}});
        return ++answers > 0;
    });
    EXPECT_EQ(2, answers);
}

}  // namespace
}  // namespace NORVZEL20
