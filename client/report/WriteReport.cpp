#include "client/report/WriteReport.h"

#include "client/report/CimXmlFormat.h"
#include "client/report/JsonFormat.h"
#include "client/report/TTextFormat.h"

namespace NORVZEL20 {

void WriteReport(const TComparisonReport& report, EOutputFormat format, bool isColored, const TTextSink& sink)
{
    switch (format) {
    case EOutputFormat::kText:
        return TTextFormat(report, isColored).Write(sink);
    case EOutputFormat::kJson:
        return WriteJsonReport(report, sink);
    case EOutputFormat::kNdjson:
        return WriteNdjsonReport(report, sink);
    case EOutputFormat::kCimXml:
        return WriteCimXmlReport(report, sink);
    }
}

}  // namespace NORVZEL20
