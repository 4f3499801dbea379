#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <string_view>
#include <vector>

#include "host/Export.h"
#include "host/ICIMClass.h"
#include "host/ICIMInstance.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// Writes a namespace as CIM-XML (DSP0201). Loading the document gives an equal namespace.
///
/// Text goes to the sink in pieces of about 64 KiB, in UTF-8; no more than that is held. Characters that XML readers would change
/// are written as character references; a control character that XML 1.0 cannot carry becomes U+FFFD. The output depends on the
/// contents of the namespace alone.
/// Errors: what the sink or the namespace throws. If reading an element throws, nothing of that element is written. If the sink
/// throws, its piece is kept, including the element that filled it; the next piece begins with it, and calling EndDocument again
/// offers it again. StartDocument discards it.
/// Threads: one at a time; the namespace must not change meanwhile.
class CIMDELTA_EXPORT TCimXmlWriter {
  public:
    using TSink = boost::function<void(std::string_view)>;

    explicit TCimXmlWriter(TSink sink);
    TCimXmlWriter(const TCimXmlWriter&) = delete;
    TCimXmlWriter& operator=(const TCimXmlWriter&) = delete;

    /// Writes a whole document: CIM, DECLARATION and DECLGROUP with qualifier declarations, classes (superclasses first) and
    /// instances (class by class in that order, each in order of insertion). The group names `namespaceName` unless it is empty,
    /// with `host` unless that is empty.
    void WriteNamespace(ICIMNamespace& ns, const std::string& namespaceName = std::string(),
                        const std::string& host = std::string());

    /// The parts, for callers that choose what to write: StartDocument, any number of the others, EndDocument.
    void StartDocument(const std::string& namespaceName = std::string(), const std::string& host = std::string());
    void WriteQualifierDecl(const ICIMQualifierDecl& decl);
    /// One VALUE.OBJECT with the CLASS: its own qualifiers, and the properties and methods that it declares itself. A class of
    /// another host shows inherited ones too; see TStoredObjects::FromClass.
    void WriteClass(const ICIMClass& cls);
    /// One VALUE.OBJECT with the INSTANCE; null properties are written without a value.
    void WriteInstance(const ICIMInstance& instance);
    /// Writes the end tags and the last piece. If the sink throws, call it again to offer that piece again.
    void EndDocument();

    /// The element INSTANCE alone, in one line.
    static std::string InstanceToXml(const ICIMInstance& instance);

  private:
    static std::vector<boost::shared_ptr<ICIMClass>> CollectClasses(ICIMNamespace& ns);
    template <class TAppend>
    void WriteElement(const TAppend& append);
    void Flush();

    TSink fSink;
    std::string fBuffer;
    bool fEnded = false;  // the end tags are in the buffer, or written
};

}  // namespace NORVZEL20
