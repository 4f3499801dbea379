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

/// The same for documents that no reader accepts, for one reason and in one place each.
inline THostileRow Refused(const std::string& name, const THostileDocument& document, unsigned line, const std::string& reason,
                           const std::string& populatorPlace)
{
    return {name, document, "line " + std::to_string(line) + ": " + reason, "hostile.xml:" + populatorPlace + ": " + reason,
            "status 9\nDiff-XML Parser line " + std::to_string(line) + ":" + reason};
}

}  // namespace NORVZEL20
