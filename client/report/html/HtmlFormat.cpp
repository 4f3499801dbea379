// The page is report.html with these marks replaced:
//
//   {{policy}}    what the browser may do: run this script and this style, known by their digests, and nothing else
//   {{style}}     report.css
//   {{overview}}  JSON, packed (see PageOverview.cpp)
//   {{script}}    the scripts
//   {{rows}}      the columns, packed (see CollectPageData.cpp)
//
// Packed is gzip in base64, so nothing that an inventory holds can be taken for markup. The overview stands in front of the script
// and the rows behind it: a browser draws the findings while it still reads the rows.
//
// The rows are the length of a head, the head, the columns and the texts. The head is JSON, filled up with blanks so that the
// numbers behind it, of four bytes each, stand at multiples of four:
//
//   { "columns": [ [ "rowInstance", 5 ], ..., [ "textLength", 30 ] ] }
#include "client/report/html/HtmlFormat.h"

#include <stdexcept>
#include <string>

#include "client/report/html/Base64.h"
#include "client/report/html/CollectPageData.h"
#include "client/report/html/LittleEndian.h"
#include "client/report/html/PageOverview.h"
#include "client/report/html/PageSources.h"
#include "client/report/html/Sha256.h"
#include "client/report/html/TPackedText.h"

namespace NORVZEL20 {

namespace {

std::string Policy()
{
    const auto hash = [](std::string_view source) { return "'sha256-" + EncodeBase64(Sha256(source)) + "'"; };
    return "default-src 'none'; script-src " + hash(PageScript()) + "; style-src " + hash(PageStyle()) +
           "; base-uri 'none'; form-action 'none'";
}

void WriteOverview(const TComparisonReport& report, const TPageData& data, const TTextSink& sink)
{
    TPackedText packed(sink);
    packed.Add(MakePageOverview(report, data).dump(-1, ' ', false, nlohmann::ordered_json::error_handler_t::replace));
    packed.End();
}

std::string HeadOf(const TPageData& data)
{
    nlohmann::ordered_json columns = nlohmann::ordered_json::array();
    for (int i = 0; i < TPageColumns::kColumnCount; ++i) {
        const auto column = static_cast<TPageColumns::EColumn>(i);
        columns.push_back({TPageColumns::GetName(column), data.columns.GetCount(column)});
    }
    columns.push_back({"textLength", data.texts.GetCount()});
    std::string head = nlohmann::ordered_json{{"columns", columns}}.dump();
    head.append((4 - head.size() % 4) % 4, ' ');
    return head;
}

void WriteRows(const TPageData& data, const TTextSink& sink)
{
    TPackedText packed(sink);
    const TSpooledText::TCallback add = [&packed](std::string_view piece) { packed.Add(piece); };
    const std::string head = HeadOf(data);
    TSpooledText length;
    AppendNumber(length, head.size());
    length.ForEachPiece(add);
    packed.Add(head);
    for (int i = 0; i < TPageColumns::kColumnCount; ++i) {
        data.columns.GetNumbers(static_cast<TPageColumns::EColumn>(i)).ForEachPiece(add);
    }
    data.texts.GetLengths().ForEachPiece(add);
    data.texts.GetTexts().ForEachPiece(add);
    packed.End();
}

void WriteMark(std::string_view mark, const TComparisonReport& report, const TPageData& data, const TTextSink& sink)
{
    if (mark == "policy") {
        return sink(Policy());
    }
    if (mark == "style") {
        return sink(PageStyle());
    }
    if (mark == "overview") {
        return WriteOverview(report, data, sink);
    }
    if (mark == "script") {
        return sink(PageScript());
    }
    if (mark == "rows") {
        return WriteRows(data, sink);
    }
    throw std::logic_error("report.html has an unknown mark: " + std::string(mark));
}

}  // namespace

void WriteHtmlReport(const TComparisonReport& report, const TTextSink& sink)
{
    TPageData data;
    CollectPageData(report, data);
    std::string_view rest = PageMarkup();
    for (std::size_t open = rest.find("{{"); open != std::string_view::npos; open = rest.find("{{")) {
        const std::size_t close = rest.find("}}", open);
        sink(rest.substr(0, open));
        WriteMark(rest.substr(open + 2, close - open - 2), report, data, sink);
        rest.remove_prefix(close + 2);
    }
    sink(rest);
}

}  // namespace NORVZEL20
