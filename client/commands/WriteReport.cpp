#include "client/commands/WriteReport.h"

#include "client/findings/CollectFindings.h"
#include "client/report/CimXmlFormat.h"
#include "client/report/CsvFormat.h"
#include "client/report/JsonFormat.h"
#include "client/report/MarkdownFormat.h"
#include "client/report/TGroupedText.h"
#include "client/report/TTextFormat.h"
#include "client/report/html/HtmlFormat.h"

namespace NORVZEL20 {

namespace {

void WriteText(const TComparisonReport& report, const TTextOptions& options, const TTextSink& sink)
{
    if (options.isDetailed) {
        return TTextFormat(report, options).Write(sink);
    }
    const TFindings findings = CollectFindings(report, kMostExamples, options.hasWholeKeys);
    sink(TGroupedText(report, findings, options).Write());
}

}  // namespace

void WriteReport(const TComparisonReport& report, EOutputFormat format, const TTextOptions& options, const TTextSink& sink)
{
    switch (format) {
    case EOutputFormat::kText:
        return WriteText(report, options, sink);
    case EOutputFormat::kJson:
        return WriteJsonReport(report, sink);
    case EOutputFormat::kNdjson:
        return WriteNdjsonReport(report, sink);
    case EOutputFormat::kCimXml:
        return WriteCimXmlReport(report, sink);
    case EOutputFormat::kCsv:
        return WriteCsvReport(report, sink);
    case EOutputFormat::kMarkdown:
        return WriteMarkdownReport(report, options, sink);
    case EOutputFormat::kHtml:
        return WriteHtmlReport(report, sink);
    }
}

}  // namespace NORVZEL20
