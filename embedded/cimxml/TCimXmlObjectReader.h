#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <memory>
#include <string_view>

#include "embedded/cimxml/TCimXmlPathReader.h"
#include "embedded/cimxml/TXmlReader.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/store/TInMemNamespace.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Reads embedded objects: texts of values that are themselves an INSTANCE or a CLASS, which may hold further such texts.
///
/// Errors: every operation fails through the context: kTypeMismatch (13) if the text is no embedded object or has a document type
/// declaration, kParseError (9) if objects are nested too deeply or what they hold is wrong.
class TCimXmlObjectReader {
  public:
    /// The classes of references are looked up in `ns` (may be null). `paths` is notified of references to classes that are
    /// not declared yet. `parser` reads the texts. `context` and `paths` must outlive the reader.
    TCimXmlObjectReader(TLoadContext& context, boost::shared_ptr<const TInMemNamespace> ns, TCimXmlPathReader& paths,
                        TXmlReader::EParser parser = TXmlReader::EParser::kTokenizer);
    TCimXmlObjectReader(const TCimXmlObjectReader&) = delete;
    TCimXmlObjectReader& operator=(const TCimXmlObjectReader&) = delete;
    ~TCimXmlObjectReader();

    /// The embedded object that the text describes. After an error, other texts can be read.
    TCIMValue Read(std::string_view text);
    /// The value, or for an array each of its elements, with text that looks like an object replaced by that object.
    TCIMValue ReadAll(const TCIMValue& value);

  private:
    class TNested;

    TLoadContext& fContext;
    boost::shared_ptr<const TInMemNamespace> fNamespace;
    TCimXmlPathReader& fPaths;
    const TXmlReader::EParser fParser;
    std::unique_ptr<TNested> fNested;  // made for the first object and kept, because an XML parser is expensive to make
};

}  // namespace NORVZEL20
