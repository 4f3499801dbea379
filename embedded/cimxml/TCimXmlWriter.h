#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <string_view>
#include <vector>

#include "host/ICIMClass.h"
#include "host/ICIMInstance.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// Writes a namespace as CIM-XML (DSP0201), so that loading the document gives an equal namespace.
///
/// Text reaches the sink in pieces of some 64 KiB, in UTF-8; nothing is held beyond that. What XML readers would change is
/// written as a character reference; a control character that XML 1.0 cannot carry becomes U+FFFD. Output depends on the contents
/// of the namespace alone. Errors: what the sink or the namespace throws; an element that could not be told whole is not written at
/// all. A piece that the sink refused is kept, with the element that filled it, which counts as written: the next piece begins with
/// it, and EndDocument may be called again to offer it again. StartDocument begins anew.
class TCimXmlWriter {
  public:
    using TSink = boost::function<void(std::string_view)>;

    explicit TCimXmlWriter(TSink sink);
    TCimXmlWriter(const TCimXmlWriter&) = delete;
    TCimXmlWriter& operator=(const TCimXmlWriter&) = delete;

    /// The whole document: CIM, DECLARATION and DECLGROUP with qualifier declarations, classes (superclasses first) and instances
    /// (class by class in that order, each in order of insertion). `namespaceName` is named in the group where it is not empty,
    /// with `host` where that is not empty.
    void WriteNamespace(ICIMNamespace& ns, const std::string& namespaceName = std::string(),
                        const std::string& host = std::string());

    /// The parts, for documents put together by the caller: StartDocument, any number of the others, EndDocument.
    void StartDocument(const std::string& namespaceName = std::string(), const std::string& host = std::string());
    void WriteQualifierDecl(const ICIMQualifierDecl& decl);
    /// One VALUE.OBJECT with the CLASS: its own qualifiers, and the properties and methods that it declares itself.
    void WriteClass(const ICIMClass& cls);
    /// One VALUE.OBJECT with the INSTANCE; null properties are written without a value.
    void WriteInstance(const ICIMInstance& instance);
    /// Called again, it offers what the sink has not taken, if anything.
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
