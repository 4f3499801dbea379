#include <gtest/gtest.h>

#include "client/wbem/TAnswerScan.h"
#include "tests/client/wbem/TScriptedTransport.h"

namespace NORVZEL20 {
namespace {

// What the scan finds, in pieces of that size.
std::string Scan(const std::string& text, std::size_t piece)
{
    std::size_t called = 0;
    TAnswerScan scan([&called] { ++called; });
    for (std::size_t at = 0; at < text.size(); at += piece) {
        scan.Read(std::string_view(text).substr(at, piece));
    }
    const TWbemAnswer& answer = scan.Finish();
    EXPECT_EQ(called, answer.instances);
    if (const std::string fault = scan.DescribeFault(); !fault.empty()) {
        return (scan.IsCutOff() ? "cut: " : "") + fault;
    }
    std::string found = answer.operation + ": " + std::to_string(answer.instances);
    for (const std::string& name : answer.names) {
        found += " '" + name + "'";
    }
    found += answer.context.empty() ? "" : " context " + answer.context;
    found += answer.isEndOfSequence ? " end" : "";
    return found + (answer.errorCode.empty() ? "" : " error " + answer.errorCode + " " + answer.description);
}

struct TScanRow {
    const char* what;
    std::string text;
    std::string found;
};

TEST(AnswerScanTest, MessagesSayWhatTheyHold)
{
    const std::string instance =
        "<INSTANCE CLASSNAME=\"C\"><PROPERTY NAME=\"P\" TYPE=\"string\" EmbeddedObject=\"instance\"><VALUE>&lt;INSTANCE/&gt;"
        "</VALUE></PROPERTY><PROPERTY.REFERENCE NAME=\"R\"><VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"D\"><KEYBINDING "
        "NAME=\"Name\"><KEYVALUE>no</KEYVALUE></KEYBINDING></INSTANCENAME></VALUE.REFERENCE></PROPERTY.REFERENCE></INSTANCE>";
    const std::string name = "<INSTANCENAME CLASSNAME=\"N\"><KEYBINDING NAME=\"A\"><KEYVALUE>a</KEYVALUE></KEYBINDING><KEYBINDING "
                             "NAME=\"name\"><KEYVALUE "
                             "VALUETYPE=\"string\">root/a&amp;b</KEYVALUE></KEYBINDING></INSTANCENAME>";
    const std::vector<TScanRow> rows = {
        {"nothing", AnswerTo("CloseEnumeration", ""), "CloseEnumeration: 0"},
        {"instances",
         AnswerTo("E", "<IRETURNVALUE><VALUE.NAMEDINSTANCE>" + instance + "</VALUE.NAMEDINSTANCE>" + instance + "</IRETURNVALUE>"),
         "E: 2"},
        {"names", AnswerTo("E", "<IRETURNVALUE>" + name + name + "</IRETURNVALUE>"), "E: 0 'root/a&b' 'root/a&b'"},
        {"a pull",
         AnswerTo("E", "<IRETURNVALUE><VALUE.INSTANCEWITHPATH/></IRETURNVALUE><PARAMVALUE "
                       "NAME=\"EnumerationContext\"><VALUE>4711</VALUE></PARAMVALUE>"
                       "<PARAMVALUE NAME=\"EndOfSequence\"><VALUE>true</VALUE></PARAMVALUE>"),
         "E: 1 context 4711 end"},
        {"an error", ErrorAnswer("E", "6", "CIM_ERR_NOT_FOUND: x"), "E: 0 error 6 CIM_ERR_NOT_FOUND: x"},
        {"nothing at all", "", "cut: found an empty answer, expected CIM-XML"},
        {"blanks", " \r\n", "cut: found an empty answer, expected CIM-XML"},
        {"a page", "<!DOCTYPE html><html><p>Sign in<br></html>",
         "found a web page, expected CIM-XML; is this the port of a WBEM server? Those are usually 5989 (https) and 5988 (http)"},
        {"a page of XML", "<?xml version=\"1.0\"?><html/>",
         "found a web page, expected CIM-XML; is this the port of a WBEM server? Those are usually 5989 (https) and 5988 (http)"},
        {"another document", "<feed/>", "found <feed>, expected <CIM>"},
        {"a request", "<CIM><MESSAGE><SIMPLEREQ/></MESSAGE></CIM>", "found no <IMETHODRESPONSE>, expected the answer to a request"},
        {"text", "SSH-2.0-x\r\n", "found an answer that is no XML (syntax error in line 1), expected CIM-XML: \"SSH-2.0-x\\r\\n\""},
        {"cut", AnswerTo("E", instance).substr(0, 300), "cut: found an answer that ends early"},
    };
    for (const TScanRow& row : rows) {
        for (const std::size_t piece : {std::size_t{1}, std::size_t{7}, row.text.size() + 1}) {
            EXPECT_EQ(row.found, Scan(row.text, piece)) << row.what << " in pieces of " << piece;
        }
    }
}

}  // namespace
}  // namespace NORVZEL20
