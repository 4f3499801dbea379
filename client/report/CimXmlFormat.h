#pragma once

#include "client/comparison/TComparisonReport.h"
#include "client/report/TTextSink.h"

namespace NORVZEL20 {

/// The records of the run as a CIM-XML document that loads like any inventory: the delta schema and the instances of
/// KALMO_DeltaClass, KALMO_Delta and KALMO_DeltaClassAssocToDelta, in the order in which the run wrote them.
/// Errors: TZELException of the delta namespace; what the sink throws.
void WriteCimXmlReport(const TComparisonReport& report, const TTextSink& sink);

}  // namespace NORVZEL20
