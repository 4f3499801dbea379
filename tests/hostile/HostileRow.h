#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/hostile/THostileDocument.h"

namespace NORVZEL20 {

/// A hostile document, and what each reader must make of it.
struct THostileRow {
    std::string name;
    THostileDocument document;
    std::string parser;
    std::string populator;
    std::string specification;
};

/// Shows every row to every reader; the name of a row that fails is printed.
inline void ExpectOutcomes(const std::vector<THostileRow>& rows)
{
    for (const THostileRow& row : rows) {
        EXPECT_EQ(row.parser, row.document.ReadByParser()) << row.name;
        EXPECT_EQ(row.populator, row.document.LoadByPopulator()) << row.name;
        EXPECT_EQ(row.specification, row.document.ReadAsSpecification()) << row.name;
    }
}

/// The column of an inventory where the content begins when nothing stands before its element.
constexpr std::size_t kContentColumn = 148;

/// A row for what no reader accepts, for one reason: a plain error of the document, in its first line.
inline THostileRow RefusedAt(const std::string& name, const THostileDocument& document, std::size_t column,
                             const std::string& reason)
{
    return {name, document, "line 1: " + reason, "hostile.xml:1:" + std::to_string(column) + ": found malformed XML: " + reason,
            "status 9\nDiff-XML Parser line 1:" + reason};
}

/// The same where the trouble begins so many characters behind the beginning of the content.
inline THostileRow Refused(const std::string& name, const THostileDocument& document, std::size_t offset, const std::string& reason)
{
    return RefusedAt(name, document, document.prolog.size() + kContentColumn + offset, reason);
}

/// A row for a harmless content, whatever stands before it.
inline THostileRow Handled(const std::string& name, const THostileDocument& document)
{
    return {name, document, "1 elements, text 'Id'", "loaded 'Id'", "rules for 'Id'"};
}

}  // namespace NORVZEL20
