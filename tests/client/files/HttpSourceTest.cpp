// Recorded answers of HTTP as inventories.
#include <string>

#include "client/files/HttpLines.h"
#include "client/files/THttpReader.h"
#include "client/process/TClientError.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

const std::string kOk = "HTTP/1.1 200 OK\r\n";
const std::string kDeclaration = "<?xml version=\"1.0\" encoding=\"utf-8\"?>";

/// A text that is delivered in pieces.
class TTextSource : public IByteSource {
  public:
    TTextSource(std::string text, std::size_t piece) : fText(std::move(text)), fPiece(piece) {}
    std::size_t Read(char* buffer, std::size_t size) override
    {
        const std::size_t length = fText.copy(buffer, std::min(size, fPiece), fAt);
        fAt += length;
        return length;
    }

  private:
    std::string fText;
    std::size_t fPiece;
    std::size_t fAt = 0;
};

/// What the reader makes of the text, or the message.
std::string Unwrap(const std::string& text, std::size_t piece)
{
    TTextSource source(text, piece);
    THttpReader reader(source, "F");
    std::string body;
    try {
        char buffer[7];
        for (std::size_t length = 1; length > 0;) {
            length = reader.Read(buffer, sizeof buffer);
            body.append(buffer, length);
        }
        return body;
    } catch (const TClientError& error) {
        return error.what();
    }
}

struct THttpRow {
    const char* what;
    std::string text;
    std::string body;
};

/// Each row in pieces of several sizes.
void ExpectUnwrapped(std::initializer_list<THttpRow> rows)
{
    for (const THttpRow& row : rows) {
        EXPECT_TRUE(IsHttp(row.text)) << row.what;
        for (const std::size_t piece : {1, 2, 5, 1000}) {
            EXPECT_EQ(row.body, Unwrap(row.text, piece)) << row.what << " in pieces of " << piece;
        }
    }
}

TEST(HttpSourceTest, BodiesFollowOnAnEmptyLineForEachOfTheirHeaders)
{
    const std::string chunks = "3\r\n<a>\r\n5;x=y\r\n</a>\n\r\n0\r\n";
    ExpectUnwrapped({
        {"a length", kOk + "Content-Length: 4\r\n\r\n<a/>", "\n\n\n<a/>"},
        {"a length in other letters", kOk + "content-length: 0004\n\n<a/>", "\n\n\n<a/>"},
        {"headers alone", "Content-Type: text/xml\r\nContent-Length: 4\r\n\r\n<a/>", "\n\n\n<a/>"},
        {"no length", kOk + "\r\n<a/>\n", "\n\n<a/>\n"},
        {"chunks", kOk + "Transfer-Encoding: chunked\r\n\r\n" + chunks + "\r\n", "\n\n\n<a></a>\n"},
        {"chunks with a trailer", kOk + "Transfer-Encoding: chunked\r\n\r\n" + chunks + "CIMError: x\r\n\r\n", "\n\n\n<a></a>\n"},
        {"chunks alone", chunks + "\r\n", "<a></a>\n"},
        {"a declaration", kOk + "\r\n" + kDeclaration + "\n<a/>", "\n\n" + std::string(kDeclaration.size(), ' ') + "\n<a/>"},
        {"a declaration of another encoding", kOk + "\r\n<?xml version=\"1.0\" encoding=\"iso-8859-1\"?><a/>",
         "<?xml version=\"1.0\" encoding=\"iso-8859-1\"?><a/>"},
        {"several answers", kOk + "Content-Length: 4\r\n\r\n<a/>\r\n" + kOk + "Content-Length: 4\r\n\r\n<b/>",
         "\n\n\n<a/>\n\n\n\n<b/>"},
        {"an interim answer", "HTTP/1.1 100 Continue\r\n\r\n" + kOk + "Content-Length: 4\r\n\r\n<a/>", "\n\n\n\n\n<a/>"},
        {"a challenge and the answer",
         "HTTP/1.1 401 Unauthorized\r\nContent-Length: 4\r\n\r\nno\r\n" + kOk + "Content-Length: 4\r\n\r\n<a/>",
         "\n\n\n\n\n\n\n<a/>"},
        {"no body and another", kOk + "Content-Length: 0\r\n\r\n" + kOk + "\r\n<a/>", "\n\n\n\n\n<a/>"},
        {"headers with odd names", kOk + "X: 1\r\nmy_header.2: 2\r\n\r\n<a/>", "\n\n\n\n<a/>"},
        {"empty lines in front", "\r\n\n" + kOk + "\r\n<a/>", "\n\n\n\n<a/>"},
        {"a byte order mark in front", "\xef\xbb\xbf" + kOk + "\r\n<a/>", "\n\n<a/>"},
    });
}

TEST(HttpSourceTest, WhatIsNoAnswerWithObjectsIsRefusedWithItsLine)
{
    ExpectUnwrapped({
        {"a request", "POST /cimom HTTP/1.1\r\n\r\n",
         "F:1: found a request of HTTP, which is no inventory; load the server's answer instead"},
        {"a request of the other kind", "M-POST /cimom HTTP/1.1\r\n\r\n",
         "F:1: found a request of HTTP, which is no inventory; load the server's answer instead"},
        {"only challenges", "HTTP/1.1 302 Found\r\nContent-Length: 0\r\n\r\nHTTP/1.1 401 Unauthorized\r\nContent-Length: 0\r\n\r\n",
         "F:6: found the answer \"401 Unauthorized\", expected one with objects; ask with the name and the password of a user"},
        {"a challenge behind an answer",
         kOk + "Content-Length: 4\r\n\r\n<a/>HTTP/1.1 401 Unauthorized\r\nContent-Length: 0\r\n\r\n",
         "F:6: found the answer \"401 Unauthorized\", expected one with objects; ask with the name and the password of a user"},
        {"another status", "HTTP/1.1 401 Unauthorized\r\nContent-Length: 0\r\n\r\n",
         "F:3: found the answer \"401 Unauthorized\", expected one with objects; ask with the name and the password of a user"},
        {"a status of no access", "HTTP/1.1 403 Forbidden\r\n\r\n",
         "F:2: found the answer \"403 Forbidden\", expected one with objects; ask as a user who may read this"},
        {"a status of a wrong address", "HTTP/1.1 404 Not Found\r\n\r\n",
         "F:2: found the answer \"404 Not Found\", expected one with objects; correct the path in the address of the server"},
        {"another status with its reason", "HTTP/1.1 400 Bad Request\r\nCIMError: unsupported-operation\r\n\r\n",
         "F:3: found the answer \"400 Bad Request\" (CIMError: unsupported-operation), expected one with objects; ask the server"
         " again"},
    });
}

TEST(HttpSourceTest, AnAnswerThatContradictsItselfIsRefusedWithItsLine)
{
    const std::string chunked = kOk + "Transfer-Encoding: chunked\r\n\r\n";
    ExpectUnwrapped({
        {"a body that ends early", kOk + "Content-Length: 9\r\n\r\n<a/>",
         "F:4: the body ends 5 bytes early; it was cut off, so fetch it again"},
        {"a length that is none", kOk + "Content-Length: x\r\n\r\n<a/>", "F:2: found the Content-Length \"x\", expected a number"},
        {"a compressed body", kOk + "Content-Encoding: gzip\r\n\r\n<a/>",
         "F:2: found a body compressed with gzip; record the answer without compression"},
        {"a line that is no header", kOk + "<a/>",
         "F:2: found \"<a/>\", expected a header of HTTP or an empty line behind the headers"},
        {"a chunk that is too short", chunked + "9\r\n<a/>", "F:5: the body ends 5 bytes early; it was cut off, so fetch it again"},
        {"a chunk that is too long", chunked + "3\r\n<a/>\r\n0\r\n\r\n",
         "F:5: found more bytes than the chunk's length says, expected the end of a line"},
        {"a chunk whose length takes the end of its line", chunked + "4\r\n<a/>\r\n1\r\n\r\n\r\n0\r\n\r\n",
         "F:7: found more bytes than the chunk's length says, expected the end of a line"},
        {"bytes behind the body", kOk + "Content-Length: 3\r\n\r\n<a/>\r\n",
         "F:4: found \">\" behind the body, expected another answer or the end; its Content-Length is wrong"},
        {"no body", kOk + "Content-Length: 0\r\n\r\n", "F:4: found no body, expected an answer with objects; fetch it again"},
        {"headers that end early", kOk + "Content-Length: 4\r\n\r\n<a/>\r\n" + kOk + "Content-Type: appl",
         "F:7: the headers of an answer end early; it was cut off, so fetch it again"},
        {"a status line alone", "HTTP/1.1 200 OK", "F:2: the headers of an answer end early; it was cut off, so fetch it again"},
        {"no last chunk", chunked + "4\r\n<a/>\r\n",
         "F:6: the answer ends in the middle of its chunks; it was cut off, so fetch it again"},
        {"a length of a chunk that is none", chunked + "zz\r\n<a/>", "F:4: found \"zz\", expected the length of a chunk"},
    });
}

TEST(HttpSourceTest, OtherFilesAreNotTakenForHttp)
{
    for (const char* text : {"<CIM/>", "<?xml version=\"1.0\"?><CIM/>", "\n<CIM/>", "", "class A : B {};", "// MOF", "[Key] class",
                             "123\r\n", "a\r\nb", "x: 1", "a_b: 1", "instance of A { p = 1; };"}) {
        EXPECT_FALSE(IsHttp(text)) << text;
    }
}

/// What a client and a server have exchanged, as it was recorded.
class WireTest : public TClientFixture {
  protected:
    std::string Show(const std::string& names)
    {
        const std::string folder = "../../data/wire/";
        std::string files;
        for (std::size_t at = 0; at < names.size();) {
            const std::size_t end = std::min(names.find(' ', at), names.size());
            files += (files.empty() ? "" : ",") + folder + names.substr(at, end - at);
            at = end + 1;
        }
        Run({"show", files});
        return fStatus == 2 ? Shorten(fErr, folder, "") : fOut;
    }

    const std::string fClasses = "025-pywbem-EnumerateClasses.response ";
};

TEST_F(WireTest, AnswersLoadAsTheyWereRecorded)
{
    const std::string some = "DEB_PackageDependency: ";
    EXPECT_EQ(some + "0 instances\nDEB_Package: 1 instance\n", Show(fClasses + "031-pywbem-GetInstance.response"));
    EXPECT_EQ(some + "0 instances\nDEB_Package: 26 instances\n", Show(fClasses + "032-pywbem-Associators.response"));
    EXPECT_EQ(some + "26 instances\nDEB_Package: 0 instances\n", Show("034-pywbem-References.response " + fClasses));
    EXPECT_EQ(some + "0 instances\nDEB_Package: 94 instances\n",
              Show(fClasses + "036-pywbem-OpenEnumerateInstances-Pull.response 031-pywbem-GetInstance.response"));
}

TEST_F(WireTest, WhatIsNoInventoryIsRefused)
{
    EXPECT_EQ(
        "cimdelta: 001-wbemcli-ecn.response:12:1: found a list of names; names have no values, so load the objects instead, for"
        " instance the answer to EnumerateInstances instead of the one to EnumerateInstanceNames\n",
        Show("001-wbemcli-ecn.response"));
    EXPECT_EQ("cimdelta: 019-wbemcli-err-class.response:11:1: found an error as the answer to \"GetClass\": CIM_ERR_NOT_FOUND (6),"
              " \"CIM_ERR_NOT_FOUND: DEB_Missing\"; expected an answer with objects; correct the name in the request\n",
              Show("019-wbemcli-err-class.response"));
    EXPECT_EQ("cimdelta: 031-pywbem-GetInstance.request:1: found a request of HTTP, which is no inventory; load the server's answer"
              " instead\n",
              Show("031-pywbem-GetInstance.request"));
}

}  // namespace
}  // namespace NORVZEL20
