#include "client/report/html/TPageColumns.h"

#include "client/report/html/LittleEndian.h"

namespace NORVZEL20 {

const char* TPageColumns::GetName(EColumn column)
{
    static const std::array<const char*, kColumnCount> kNames = {
        "rowInstance",          "rowSet",          "rowContent",      "rowDifference",
        "instanceName",         "instanceKey",     "instanceLacking", "instanceSharing",
        "instancePath",         "changeReference", "changeShort",     "changeGroups",
        "groupValue",           "groupSet",        "groupCounts",     "contentPairs",
        "contentDisagreements", "pairProperty",    "pairValue",       "disagreementProperty",
        "disagreementChange",   "listNumbers",     "number"};
    return kNames[column];
}

void TPageColumns::Add(EColumn column, std::size_t number)
{
    AppendNumber(fNumbers[column], number);
    ++fCounts[column];
}

}  // namespace NORVZEL20
