#include "client/report/CimXmlFormat.h"

#include <string_view>

#include "embedded/cimxml/TCimXmlWriter.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

std::string WriteCimXmlReport(const TComparisonReport& report)
{
    std::string text;
    TCimXmlWriter writer([&text](std::string_view piece) { text += piece; });
    // The records' classes live in the delta namespace's store, which holds nothing else.
    writer.WriteNamespace(*report.records->GetClass(kDeltaRecord, TCallContext())->GetNamespace(TCallContext()));
    return text;
}

}  // namespace NORVZEL20
