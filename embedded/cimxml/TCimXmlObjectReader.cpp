// Embedded objects.
//
// The value of a string property may be the text of an <INSTANCE> or a <CLASS>, escaped as text:
//
//     <VALUE>&lt;INSTANCE CLASSNAME="Disk"&gt;...&lt;/INSTANCE&gt;</VALUE>
//
// Such text is a document of its own: it is parsed by another TXmlReader into another TCimXmlReader, one that has no loader and so
// keeps the object. Objects within that object are read by the object reader of that reader, and so on, down to a fixed depth.
// Each text could declare entities and expand them up to the limit of a whole document, so a document type is refused here.
#include "embedded/cimxml/TCimXmlObjectReader.h"

#include <utility>

#include "embedded/cimxml/TCimXmlReader.h"
#include "embedded/cimxml/TXmlReader.h"
#include "embedded/load/MessageText.h"
#include "embedded/load/ReadEachText.h"
#include "embedded/value/TEmbeddedObject.h"

namespace NORVZEL20 {

/// The readers for one level of nesting.
class TCimXmlObjectReader::TNested {
  public:
    TNested(TLoadContext& context, const boost::shared_ptr<const TInMemNamespace>& ns, TXmlReader::EParser parser)
        : fContext(context), fReader(context, ns, nullptr, parser), fXml(fReader, parser)
    {
        fXml.RefuseDocumentTypes();
    }

    boost::shared_ptr<const TEmbeddedObject> Read(std::string_view text)
    {
        fReader.Reset();
        fXml.Reset("UTF-8");
        if (!fXml.Parse(text.data(), text.size(), true)) {
            fContext.Fail(TZELStatusCode::kTypeMismatch,
                          "found " + Quote(text) + ", expected an <INSTANCE> or a <CLASS> (" + fXml.GetError() + ")");
        }
        return fReader.TakeObject();
    }

    bool TakeMetUnsettled() noexcept { return fReader.TakeMetUnsettled(); }

  private:
    TLoadContext& fContext;
    TCimXmlReader fReader;
    TXmlReader fXml;
};

TCimXmlObjectReader::TCimXmlObjectReader(TLoadContext& context, boost::shared_ptr<const TInMemNamespace> ns,
                                         TCimXmlPathReader& paths, TXmlReader::EParser parser)
    : fContext(context), fNamespace(std::move(ns)), fPaths(paths), fParser(parser)
{}

TCimXmlObjectReader::~TCimXmlObjectReader() = default;

TCIMValue TCimXmlObjectReader::Read(std::string_view text)
{
    const TLoadContext::TEmbedded embedded(fContext);
    try {
        if (!fNested) {
            fNested = std::make_unique<TNested>(fContext, fNamespace, fParser);
        }
        TCIMValue value(fNested->Read(text));
        if (fNested->TakeMetUnsettled()) {
            fPaths.NoteUnsettled();
        }
        return value;
    } catch (...) {
        fNested.reset();  // it is in the middle of the text
        throw;
    }
}

TCIMValue TCimXmlObjectReader::ReadAll(const TCIMValue& value)
{
    return ReadEachText(value, [this](const TCIMValue& text) {
        return TEmbeddedObject::IsPerhapsText(text.GetString()) ? Read(text.GetString()) : text;
    });
}

}  // namespace NORVZEL20
