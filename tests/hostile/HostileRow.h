#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/hostile/THostileDocument.h"

namespace NORVZEL20 {

/// The memory that reading a document of a few lines may take.
constexpr std::size_t kSmallBound = 256 * 1024;

/// A hostile document and the outcome that each reader must have (see THostileDocument).
struct THostileRow {
    std::string name;
    THostileDocument document;
    std::string parser;
    std::string populator;
    std::string specification;
    std::size_t bound = kSmallBound;  ///< bytes that a reader may hold at a time
};

/// A reader may allocate in total only a small multiple of what it may hold at a time.
inline void ExpectReading(const std::string& outcome, std::size_t bound, const TReading& reading)
{
    EXPECT_EQ(outcome, reading.outcome);
    EXPECT_LE(reading.peak, bound);
    EXPECT_LE(reading.total, 4 * bound);
}

/// Runs every reader on every row and checks outcome and memory. If a row fails, its name is printed.
inline void ExpectOutcomes(const std::vector<THostileRow>& rows)
{
    for (const THostileRow& row : rows) {
        SCOPED_TRACE(row.name);
        ExpectReading(row.parser, row.bound, row.document.ReadByParser());
        ExpectReading(row.populator, row.bound, row.document.LoadByPopulator());
        ExpectReading(row.specification, row.bound, row.document.ReadAsSpecification());
    }
}

/// The column at which the content of an inventory begins if there is no prolog.
constexpr std::size_t kContentColumn = 148;

/// A row for a document that all readers refuse for the same reason, in its first line at `column` of the inventory.
inline THostileRow RefusedAt(const std::string& name, const THostileDocument& document, std::size_t column,
                             const std::string& reason)
{
    return {name, document, "line 1: " + reason, "hostile.xml:1:" + std::to_string(column) + ": found malformed XML: " + reason,
            "status 9\nDiff-XML Parser line 1:" + reason};
}

/// The same, with the place as an offset from the beginning of the content.
inline THostileRow Refused(const std::string& name, const THostileDocument& document, std::size_t offset, const std::string& reason)
{
    return RefusedAt(name, document, document.prolog.size() + kContentColumn + offset, reason);
}

/// The row with another bound on memory, in bytes.
inline THostileRow Within(std::size_t bound, THostileRow row)
{
    row.bound = bound;
    return row;
}

/// A row for a document that all readers accept, with "Id" as its content.
inline THostileRow Handled(const std::string& name, const THostileDocument& document)
{
    return {name, document, "1 elements, text 'Id'", "loaded 'Id'", "rules for 'Id'"};
}

}  // namespace NORVZEL20
