#include "client/rules/RecordClasses.h"

#include "embedded/value/TNameText.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

bool IsRecordClass(const std::string& className)
{
    return TNameText::Equal(className, kClassRecord) || TNameText::Equal(className, kDeltaRecord) ||
           TNameText::Equal(className, kDeltaAssociation);
}

std::string DescribeRecordKeys(const std::string& className)
{
    return "rules for class " + className +
           " cannot have excludekeys, because the comparison keeps its own records in a class of that name; leave out excludekeys, "
           "or make both results with -o ndjson and compare those with diff";
}

}  // namespace NORVZEL20
