// One document, from bytes to a load:
//
//     file, memory or source --bytes--> TXmlReader --events--> TCimXmlReader --classes, instances--> TLoader of the session
//
// TDocument owns the readers. They live for one document only; what documents share belongs to the session.
#include "embedded/cimxml/TCimXmlDocuments.h"

#include <algorithm>
#include <boost/ref.hpp>
#include <boost/smart_ptr/make_shared.hpp>
#include <string_view>

#include "embedded/cimxml/ReadObjectKey.h"
#include "embedded/cimxml/TCimXmlObjectReader.h"
#include "embedded/cimxml/TCimXmlPathReader.h"
#include "embedded/cimxml/TCimXmlReader.h"
#include "embedded/cimxml/TXmlReader.h"
#include "embedded/load/TFileSource.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/load/TLoader.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

namespace {

using EStatus = TZELStatusCode::EStatusCode;

constexpr std::size_t kReadPiece = 256 * 1024;

/// One document, from its first byte to its end.
class TDocument {
  public:
    TDocument(TLoadSession& session, const std::string& name, TXmlReader::EParser parser)
        : fContext(session.GetContext()), fReader(fContext, session.GetNamespace(), &session.GetLoader(), parser),
          fXml(fReader, parser)
    {
        fXml.ReadSequence();
        fContext.BeginDocument(name, fXml);
    }

    void ReadMemory(const char* data, std::size_t length)
    {
        RefuseEmpty(length);
        NoteFirst(std::string_view(data, length));
        Check(fXml.Parse(data, length, true));
    }

    void ReadSource(const TCimXmlDocuments::TPullSource& source)
    {
        std::size_t total = 0;
        std::size_t length = 0;
        std::size_t room = 0;
        do {
            // A tag that has not ended is read again with each piece. Pieces as long as that tag keep the total linear.
            room = std::max(kReadPiece, fXml.GetPending());
            char* const buffer = fXml.GetBuffer(room);
            length = Fill(source, buffer, room);
            total += length;
            NoteFirst(std::string_view(buffer, length));
            Check(fXml.ParseBuffer(length));
        } while (length == room);
        RefuseEmpty(total);
        Check(fXml.Finish());
    }

  private:
    /// Pulls until the room is full or the document ends: many small pieces would be parsed slowly.
    static std::size_t Fill(const TCimXmlDocuments::TPullSource& source, char* buffer, std::size_t room)
    {
        std::size_t length = 0;
        while (length < room) {
            const std::size_t more = source(buffer + length, room - length);
            if (more == 0) {
                break;
            }
            length += more;
        }
        return length;
    }

    /// Notes the first byte that is no blank and no part of a byte order mark, and its place. What does not begin with "<" is no
    /// XML, and where the parser gives up is of no interest then.
    void NoteFirst(std::string_view text)
    {
        constexpr std::string_view kBlanks(" \t\r\n");
        constexpr std::string_view kMark("\0\xef\xbb\xbf\xfe\xff", 6);  // in UTF-16, a zero byte belongs to each blank
        for (std::size_t i = 0; i < text.size() && fFirst == '\0'; ++i) {
            if (text[i] == '\n') {
                fFirstPlace = {fFirstPlace.line + 1, 1};
            } else if (kBlanks.find(text[i]) != std::string_view::npos) {
                ++fFirstPlace.column;
            } else if (kMark.find(text[i]) == std::string_view::npos) {
                fFirst = text[i];
            }
        }
    }

    void RefuseEmpty(std::size_t length) const
    {
        if (length == 0) {
            fContext.Fail(EStatus::kParseError, "found an empty document, expected CIM-XML");
        }
    }

    void Check(bool succeeded) const
    {
        if (succeeded) {
            return;
        }
        if (fFirst != '\0' && fFirst != '<') {
            const TLoadContext::TAt at(fContext, {fContext.CountDocuments() - 1, fFirstPlace});
            fContext.Fail(EStatus::kParseError, "found no XML, expected CIM-XML", EAdvice::kLeaveFileOut);
        }
        const std::string open = fReader.GetOpenElement();
        const std::string end = fXml.IsCutOff() && !open.empty()
                                    ? "; the document ends within <" + open + ">, so it was cut off: fetch or write it again"
                                    : "";
        fContext.Fail(EStatus::kParseError, "found malformed XML: " + fXml.GetError() + end);
    }

    TLoadContext& fContext;
    TCimXmlReader fReader;
    TXmlReader fXml;
    char fFirst = '\0';  // see NoteFirst
    TTextPlace fFirstPlace{1, 1};
};

/// Reads texts when all documents have ended, for classes that were declared after the instances.
class TLateObjects {
  public:
    explicit TLateObjects(TLoadSession& session)
        : fPaths(session.GetContext(), session.GetNamespace()),
          fObjects(session.GetContext(), session.GetNamespace(), fPaths, TXmlReader::EParser::kTokenizer)
    {}

    TCIMValue ReadAll(const TCIMValue& value) { return fObjects.ReadAll(value); }

  private:
    TCimXmlPathReader fPaths;
    TCimXmlObjectReader fObjects;
};

}  // namespace

TCimXmlDocuments::TCimXmlDocuments(TLoadSession& session) : fSession(session)
{
    session.GetNamespace()->SetObjectReader(&ReadObjectKey);
    const auto late = boost::make_shared<TLateObjects>(session);
    session.SetObjectReader([late](const TCIMValue& value) { return late->ReadAll(value); });
}

template <class TRead>
void TCimXmlDocuments::Read(const std::string& name, TRead read)
{
    TDocument document(fSession, name, fUsesExpatAlone ? TXmlReader::EParser::kExpat : TXmlReader::EParser::kTokenizer);
    read(document);
    fSession.GetContext().EndDocument();
}

void TCimXmlDocuments::ReadMemory(const char* data, std::size_t length, const std::string& name)
{
    Read(name, [&](TDocument& document) { document.ReadMemory(data, length); });
}

void TCimXmlDocuments::ReadSource(const TPullSource& source, const std::string& name)
{
    Read(name, [&](TDocument& document) { document.ReadSource(source); });
}

/// The source is passed by reference, because it owns the open file.
void TCimXmlDocuments::ReadFile(const std::string& path)
{
    TFileSource file(path);
    ReadSource(boost::ref(file), path);
}

}  // namespace NORVZEL20
