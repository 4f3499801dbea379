#pragma once

namespace NORVZEL20 {

/// How a result is written.
enum class EOutputFormat {
    kText,      ///< for people
    kJson,      ///< one JSON document
    kNdjson,    ///< JSON documents, one a line
    kCimXml,    ///< CIM-XML that loads like any inventory
    kCsv,       ///< a table for spreadsheets; only of a comparison
    kMarkdown,  ///< for tickets and summaries of CI runs; only of a comparison
    kHtml       ///< a page for a browser; only of a comparison
};

}  // namespace NORVZEL20
