#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/hostile/THostileDocument.h"

namespace NORVZEL20 {

/// What reading a document of a few lines may take.
constexpr std::size_t kSmallBound = 256 * 1024;

/// A hostile document, and what each reader must make of it.
struct THostileRow {
    std::string name;
    THostileDocument document;
    std::string parser;
    std::string populator;
    std::string specification;
    std::size_t bound = kSmallBound;  ///< bytes that any of the readers may hold at a time
};

/// Readers free as they go, so that all they ever allocate is a small multiple of what they hold at a time.
inline void ExpectReading(const std::string& told, std::size_t bound, const TReading& reading)
{
    EXPECT_EQ(told, reading.told);
    EXPECT_LE(reading.peak, bound);
    EXPECT_LE(reading.total, 4 * bound);
}

/// Shows every row to every reader, and looks at what each makes of it and at the memory that takes; the name of a row that fails
/// is printed.
inline void ExpectOutcomes(const std::vector<THostileRow>& rows)
{
    for (const THostileRow& row : rows) {
        SCOPED_TRACE(row.name);
        ExpectReading(row.parser, row.bound, row.document.ReadByParser());
        ExpectReading(row.populator, row.bound, row.document.LoadByPopulator());
        ExpectReading(row.specification, row.bound, row.document.ReadAsSpecification());
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

/// The row with another bound on memory.
inline THostileRow Within(std::size_t bound, THostileRow row)
{
    row.bound = bound;
    return row;
}

/// A row for a harmless content, whatever stands before it.
inline THostileRow Handled(const std::string& name, const THostileDocument& document)
{
    return {name, document, "1 elements, text 'Id'", "loaded 'Id'", "rules for 'Id'"};
}

}  // namespace NORVZEL20
