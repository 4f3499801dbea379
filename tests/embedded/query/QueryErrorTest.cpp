#include "embedded/query/TQueryError.h"

#include <string>
#include <vector>

#include "embedded/query/TQuery.h"
#include "tests/embedded/store/TInMemFixture.h"

namespace NORVZEL20 {
namespace {

class QueryErrorTest : public TInMemFixture {
  protected:
    QueryErrorTest()
    {
        DeclareDisk();
        fNamespace->FindClass("Disk")->AddPropertyDecl(Decl({"On", TType::kBoolean, {}}));
        fNamespace->FindClass("Disk")->AddPropertyDecl(Decl({"Since", TType::kDateTime, {}}));
        fNamespace->FindClass("Disk")->AddPropertyDecl(Decl({"Next", TType::kReference, {}}));
    }

    /// `status: text`, or "no error".
    std::string ErrorOf(const std::string& query, const std::string& language = "WQL")
    {
        try {
            TQuery(language, query).Execute(*fNamespace, [](boost::shared_ptr<ICIMInstance>) { return true; });
        } catch (const TQueryError& error) {
            return std::to_string(error.GetStatusCode().GetStatus()) + ": " + error.what();
        }
        return "no error";
    }

    struct TErrorRow {
        const char* query;
        const char* error;
    };

    void ExpectErrors(const std::vector<TErrorRow>& rows)
    {
        for (const TErrorRow& row : rows) {
            EXPECT_EQ(row.error, ErrorOf(row.query)) << row.query;
        }
    }
};

TEST_F(QueryErrorTest, WhatCannotBeParsedIsReportedWithItsPlace)
{
    ExpectErrors({
        {"", "16: query, column 1: expected SELECT, found the end of the query"},
        {"SELEC * FROM Disk", "16: query, column 1: expected SELECT, found 'SELEC'"},
        {"SELECT", "16: query, column 7: expected * or the name of a property, found the end of the query"},
        {"SELECT FROM Disk", "16: query, column 8: expected * or the name of a property, found 'FROM'"},
        {"SELECT * FORM Disk", "16: query, column 10: expected FROM, found 'FORM'"},
        {"SELECT Id Size FROM Disk", "16: query, column 11: expected FROM, found 'Size'"},
        {"SELECT Id, FROM Disk", "16: query, column 12: expected * or the name of a property, found 'FROM'"},
        {"SELECT * FROM", "16: query, column 14: expected the name of a class, found the end of the query"},
        {"SELECT * FROM 'Disk'", "16: query, column 15: expected the name of a class, found 'Disk'"},
        {"SELECT * FROM Disk Id", "16: query, column 20: expected WHERE or the end of the query, found 'Id'"},
        {"SELECT * FROM Disk WHERE", "16: query, column 25: expected a property or a value, found the end of the query"},
        {"SELECT * FROM Disk WHERE Id",
         "16: query, column 28: expected =, <>, <, <=, >, >=, LIKE, IS or ISA, found the end of the query"},
        {"SELECT * FROM Disk WHERE Id = ", "16: query, column 31: expected a property or a value, found the end of the query"},
        {"SELECT * FROM Disk WHERE Id == 'a'", "16: query, column 30: expected a property or a value, found '='"},
        {"SELECT * FROM Disk WHERE Id = 'a", "16: query, column 31: the text that begins here has no second quote"},
        {"SELECT * FROM Disk WHERE Id = 'a' Id", "16: query, column 35: expected AND, OR or the end of the query, found 'Id'"},
        {"SELECT * FROM Disk WHERE (Id = 'a'", "16: query, column 35: expected AND, OR or ), found the end of the query"},
        {"SELECT * FROM Disk WHERE Id LIKE Label", "16: query, column 34: expected a pattern in quotes, found 'Label'"},
        {"SELECT * FROM Disk WHERE Id IS 'a'", "16: query, column 32: expected NULL or NOT NULL, found 'a'"},
        {"SELECT * FROM Disk WHERE Id IS NOT 'a'", "16: query, column 36: expected NULL, found 'a'"},
        {"SELECT * FROM Disk WHERE Id ISA 5", "16: query, column 33: expected the name of a class, found '5'"},
        {"SELECT * FROM Disk WHERE Size = 5; DROP", "16: query, column 34: a query has no ';' here"},
    });
}

TEST_F(QueryErrorTest, WhatHasNoMeaningIsReportedWithItsPlace)
{
    ExpectErrors({
        {"SELECT * FROM Disk WHERE Disk = 1", "15: query, column 26: class 'Disk' has no property 'Disk'"},
        {"SELECT * FROM Disk WHERE Id = Disk", "15: query, column 31: class 'Disk' has no property 'Disk'"},
        {"SELECT Tape.Id FROM Disk", "16: query, column 8: 'Tape' is not the class of this query"},
        {"SELECT * FROM Disk WHERE 'a' ISA Disk",
         "16: query, column 26: ISA asks for the class of a property or of the query's own class, not of a value"},
        {"SELECT * FROM Disk WHERE Tape.Id = 'a'", "16: query, column 26: 'Tape' is not the class of this query"},
        {"SELECT * FROM Disk WHERE Size = 5x", "16: query, column 33: '5x' is no number"},
        {"SELECT * FROM Tape", "15: query, column 15: there is no class 'Tape'"},
        {"SELECT Id, Colour FROM Disk", "15: query, column 12: class 'Disk' has no property 'Colour'"},
        {"SELECT * FROM Disk WHERE Id = Colour", "15: query, column 31: class 'Disk' has no property 'Colour'"},
        {"SELECT * FROM Disk WHERE Size = 'a'", "16: query, column 26: 'Size' (uint64) and the value (string) do not compare"},
        {"SELECT * FROM Disk WHERE Tags = 'a'",
         "16: query, column 26: 'Tags' (string array) and the value (string) do not compare"},
        {"SELECT * FROM Disk WHERE On = 1", "16: query, column 26: 'On' (boolean) and the value (uint64) do not compare"},
        {"SELECT * FROM Disk WHERE On < TRUE", "16: query, column 26: 'On' (boolean) and the value (boolean) have no order"},
        {"SELECT * FROM Disk WHERE Next > 'a'", "16: query, column 26: 'Next' (reference) and the value (string) have no order"},
        {"SELECT * FROM Disk WHERE Since > 'today'", "16: query, column 34: 'today' is no datetime"},
        {"SELECT * FROM Disk WHERE Size LIKE '5'", "16: query, column 26: LIKE needs text, 'Size' (uint64) is none"},
        {"SELECT * FROM Disk WHERE Size ISA Disk",
         "16: query, column 26: ISA needs an embedded object or a reference, 'Size' (uint64) is none"},
    });
}

TEST_F(QueryErrorTest, AnotherLanguageIsRefused)
{
    EXPECT_EQ("17: query, column 1: the language 'SQL' is not known here; use WQL or DMTF:CQL",
              ErrorOf("SELECT * FROM Disk", "SQL"));
    EXPECT_EQ("no error", ErrorOf("SELECT * FROM Disk", "dmtf:cql"));
}

TEST_F(QueryErrorTest, DepthIsBounded)
{
    const auto nested = [](int depth, const std::string& open, const std::string& close) {
        std::string query = "SELECT * FROM Disk WHERE ";
        for (int level = 0; level < depth; ++level) {
            query += open;
        }
        query += "Size = 1";
        for (int level = 0; level < depth; ++level) {
            query += close;
        }
        return query;
    };
    EXPECT_EQ("no error", ErrorOf(nested(199, "(", ")")));
    EXPECT_EQ("16: query, column 226: conditions stand in each other more than 200 deep", ErrorOf(nested(200, "(", ")")));
    EXPECT_EQ("16: query, column 826: conditions stand in each other more than 200 deep", ErrorOf(nested(100000, "NOT ", "")));
}

TEST_F(QueryErrorTest, AnErrorHasItsMessageAndPosition)
{
    try {
        const TQuery query("WQL", "SELECT * FORM Disk");
        FAIL() << "accepted";
    } catch (const TQueryError& error) {
        EXPECT_EQ("expected FROM, found 'FORM'", error.GetMessage());
        EXPECT_EQ(9U, error.GetPosition());
    }
}

}  // namespace
}  // namespace NORVZEL20
