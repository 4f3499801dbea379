// Writing a namespace.
//
// The document is one group: qualifier declarations, then classes with superclasses first, then instances. Elements are appended to
// a buffer, which goes to the sink when it has reached the size of a piece. An element is appended whole or not at all: if reading
// it from the namespace throws, the buffer is cut back to where the element began. If the sink throws, the buffer is kept, so the
// same piece is offered again.
//
// Values, properties and paths are written by TValueXml; this file adds what surrounds them.
#include "embedded/cimxml/TCimXmlWriter.h"

#include <algorithm>
#include <utility>

#include "embedded/cimxml/CimXmlFlags.h"
#include "embedded/load/TStoredObjects.h"
#include "embedded/value/TValueText.h"
#include "embedded/value/TValueXml.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kWrittenPiece = 64 * 1024;

using TDecl = ICIMQualifierDecl;

void AppendFlag(std::string& out, const char* name, bool value)
{
    TValueXml::AppendAttribute(out, name, value ? "true" : "false");
}

/// ANY is not written, because no DTD has it: all scopes are written one by one.
void AppendScope(std::string& out, TDecl::EScope scope)
{
    out += "<SCOPE";
    for (const TCimXmlFlag& flag : kCimXmlScopes) {
        if ((scope & flag.bit) != 0) {
            AppendFlag(out, flag.attribute, true);
        }
    }
    out += "/>";
}

/// The parts of a namespace's name, each in an element of its own, after the host if there is one.
void AppendNamespacePath(std::string& out, const std::string& name, const std::string& host)
{
    if (!host.empty()) {
        out += "<NAMESPACEPATH><HOST>";
        TValueXml::AppendEscaped(out, host);
        out += "</HOST>";
    }
    out += "<LOCALNAMESPACEPATH>";
    for (std::size_t start = 0; start <= name.size();) {
        const std::size_t end = std::min(name.find('/', start), name.size());
        out += "<NAMESPACE";
        TValueXml::AppendAttribute(out, "NAME", std::string_view{name}.substr(start, end - start));
        out += "/>";
        start = end + 1;
    }
    out += host.empty() ? "</LOCALNAMESPACEPATH>\n" : "</LOCALNAMESPACEPATH></NAMESPACEPATH>\n";
}

/// All flavors are written, also those that are the default.
void AppendQualifierDecl(std::string& out, const ICIMQualifierDecl& decl)
{
    const TCIMValue& value = decl.GetValue(TCallContext());
    const TDecl::EFlavor flavor = decl.GetFlavor(TCallContext());
    out += "<QUALIFIER.DECLARATION";
    TValueXml::AppendAttribute(out, "NAME", decl.GetName(TCallContext()));
    TValueXml::AppendAttribute(out, "TYPE", TValueText::GetTypeName(value.GetType()));
    AppendFlag(out, "ISARRAY", value.GetType().IsArray());
    for (const TCimXmlFlag& flag : kCimXmlFlavors) {
        AppendFlag(out, flag.attribute, (flavor & flag.bit) != 0);
    }
    out += '>';
    AppendScope(out, decl.GetScope(TCallContext()));
    TValueXml::AppendValue(out, value);
    out += "</QUALIFIER.DECLARATION>\n";
}

void AppendInstance(std::string& out, const ICIMInstance& instance)
{
    out += "<INSTANCE";
    TValueXml::AppendAttribute(out, "CLASSNAME", instance.GetClass(TCallContext())->GetName(TCallContext()));
    out += '>';
    const auto append = [&](const boost::shared_ptr<ICIMProperty>& property) {
        TValueXml::AppendProperty(out, TStoredObjects::FromProperty(*property));
        return true;
    };
    instance.EnumerateProperties(append, TCallContext());
    out += "</INSTANCE>";
}

}  // namespace

TCimXmlWriter::TCimXmlWriter(TSink sink) : fSink(std::move(sink)) {}

void TCimXmlWriter::WriteNamespace(ICIMNamespace& ns, const std::string& namespaceName, const std::string& host)
{
    StartDocument(namespaceName, host);
    const auto writeDecl = [&](const boost::shared_ptr<ICIMQualifierDecl>& decl) {
        WriteQualifierDecl(*decl);
        return true;
    };
    ns.EnumerateQualifierDecls(writeDecl, TCallContext());
    const std::vector<boost::shared_ptr<ICIMClass>> classes = CollectClasses(ns);
    for (const boost::shared_ptr<ICIMClass>& cls : classes) {
        WriteClass(*cls);
    }
    const auto writeInstance = [&](const boost::shared_ptr<ICIMInstance>& instance) {
        WriteInstance(*instance);
        return true;
    };
    for (const boost::shared_ptr<ICIMClass>& cls : classes) {
        cls->EnumerateInstances(writeInstance, false, TCallContext());
    }
    EndDocument();
}

/// All classes, each after its superclass.
std::vector<boost::shared_ptr<ICIMClass>> TCimXmlWriter::CollectClasses(ICIMNamespace& ns)
{
    std::vector<boost::shared_ptr<ICIMClass>> classes;
    const auto add = [&](const boost::shared_ptr<ICIMClass>& cls) {
        classes.push_back(cls);
        return true;
    };
    ns.EnumerateRootClasses(add, TCallContext());
    for (std::size_t next = 0; next < classes.size(); ++next) {
        const boost::shared_ptr<ICIMClass> cls = classes[next];
        cls->EnumerateSubClasses(add, false, TCallContext());
    }
    return classes;
}

void TCimXmlWriter::StartDocument(const std::string& namespaceName, const std::string& host)
{
    fEnded = false;
    fBuffer.clear();  // a document that failed may have left something
    fBuffer += "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>\n";
    if (!namespaceName.empty()) {
        AppendNamespacePath(fBuffer, namespaceName, host);
    }
}

/// Appends an element whole, or nothing if `append` throws.
template <class TAppend>
void TCimXmlWriter::WriteElement(const TAppend& append)
{
    const std::size_t start = fBuffer.size();
    try {
        append(fBuffer);
    } catch (...) {
        fBuffer.resize(start);
        throw;
    }
    if (fBuffer.size() >= kWrittenPiece) {
        Flush();
    }
}

void TCimXmlWriter::WriteQualifierDecl(const ICIMQualifierDecl& decl)
{
    WriteElement([&](std::string& out) { AppendQualifierDecl(out, decl); });
}

void TCimXmlWriter::WriteClass(const ICIMClass& cls)
{
    WriteElement([&](std::string& out) {
        out += "<VALUE.OBJECT>";
        TValueXml::AppendObject(out, TStoredObjects::FromClass(cls));
        out += "</VALUE.OBJECT>\n";
    });
}

void TCimXmlWriter::WriteInstance(const ICIMInstance& instance)
{
    WriteElement([&](std::string& out) {
        out += "<VALUE.OBJECT>";
        AppendInstance(out, instance);
        out += "</VALUE.OBJECT>\n";
    });
}

/// A second call must not write the end tags again.
void TCimXmlWriter::EndDocument()
{
    if (!fEnded) {
        fBuffer += "</DECLGROUP></DECLARATION></CIM>\n";
    }
    fEnded = true;
    if (!fBuffer.empty()) {
        Flush();
    }
}

std::string TCimXmlWriter::InstanceToXml(const ICIMInstance& instance)
{
    std::string text;
    AppendInstance(text, instance);
    return text;
}

void TCimXmlWriter::Flush()
{
    fSink(fBuffer);
    fBuffer.clear();
}

}  // namespace NORVZEL20
