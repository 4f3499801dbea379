#include "client/report/CimXmlFormat.h"

#include "embedded/cimxml/TCimXmlWriter.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

void WriteCimXmlReport(const TComparisonReport& report, const TTextSink& sink)
{
    TCimXmlWriter writer(sink);
    // The records' classes live in the delta namespace's store, which holds nothing else.
    writer.WriteNamespace(*report.records->GetClass(kDeltaRecord, TCallContext())->GetNamespace(TCallContext()));
}

}  // namespace NORVZEL20
