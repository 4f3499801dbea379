// Object paths.
//
// A path is a namespace, a class and, for an instance, keys. A key may be a path itself:
//
//     <INSTANCENAME CLASSNAME="Part"><KEYBINDING NAME="On"><VALUE.REFERENCE>
//         <INSTANCENAME CLASSNAME="Disk"><KEYBINDING NAME="Id"><KEYVALUE>5</KEYVALUE></KEYBINDING></INSTANCENAME>
//     </VALUE.REFERENCE></KEYBINDING></INSTANCENAME>
//
// So there is a stack of frames, one for each open path, and values go to the innermost. The outermost frame may be the name of an
// object, which stands in front of the object and stays open until the object ends. A namespace outside of any path is the
// document's own.
//
// Two paths to the same instance must read the same. So a path within the document's namespace is stored without one, and names and
// types of keys are written as the class declares them. If the class or the document's namespace is not known yet, that happens
// later: the loader asks for it with TakeMetUnsettled.
#include "embedded/cimxml/TCimXmlPathReader.h"

#include <cstring>

#include "embedded/load/MessageText.h"
#include "embedded/store/TReferenceAdapter.h"
#include "embedded/store/TSchemaLimits.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/TValueText.h"
#include "embedded/value/Trim.h"

namespace NORVZEL20 {

namespace {

// The host's paths nest no deeper; the name of the object itself counts.
constexpr std::size_t kMaxDepth = 12;

using EStatus = TZELStatusCode::EStatusCode;
using TType = TCIMValue::TCIMType;

/// Whether a text has turned out to be a path or an embedded object.
bool BecameStructured(const TCIMValue& before, const TCIMValue& now)
{
    const TValueAccess::EForm form = TValueAccess::GetForm(now);
    return TValueAccess::IsText(before) && (form == TValueAccess::kPath || form == TValueAccess::kObject);
}

/// A number whose type the document does not give: the first of these types that can hold it.
bool ReadNumber(std::string_view text, TCIMValue& value)
{
    return TValueText::Parse(TType::kUint64, text, value) || TValueText::Parse(TType::kSint64, text, value) ||
           TValueText::Parse(TType::kReal64, text, value);
}

}  // namespace

TCimXmlPathReader::TCimXmlPathReader(TLoadContext& context, boost::shared_ptr<const TInMemNamespace> ns)
    : fContext(context), fNamespace(std::move(ns)), fFrames(1)
{}

void TCimXmlPathReader::Begin()
{
    if (++fDepth > kMaxDepth) {
        fContext.Fail(EStatus::kParseError,
                      "found object paths nested more than " + std::to_string(kMaxDepth) + " deep, expected fewer levels");
    }
    if (fDepth > fFrames.size()) {  // frames are reused, because their strings and vectors keep their memory
        fFrames.emplace_back();
    }
    TFrame& frame = fFrames[fDepth - 1];
    frame.namespaceName.clear();
    frame.host.clear();
    frame.className.clear();
    frame.keyName.clear();
    frame.isInBinding = false;
    frame.keys.clear();
}

TCIMReference TCimXmlPathReader::End()
{
    const TFrame& frame = fFrames[--fDepth];
    if (frame.className.empty()) {
        fContext.Fail(EStatus::kParseError, "found an empty <VALUE.REFERENCE>, expected the name of a class or an instance in it");
    }
    TCIMReference path;
    const boost::shared_ptr<TInMemClass> cls = FindClass(frame.className);
    if (cls) {
        path.SetClass(cls);
    } else {
        fContext.CheckName("class", frame.className);
        path.SetClassName(frame.className);
        fMetUnsettled = true;
    }
    SetPlace(path, frame);
    for (const auto& [declared, value] : frame.keys) {
        std::string name = declared.empty() ? FindOnlyKey(cls.get()) : declared;
        TCIMValue adapted = value;
        if (!cls || TReferenceAdapter(*fNamespace, fContext.GetEmbeddedDepth()).AdaptKey(*cls, name, adapted) == nullptr) {
            fContext.CheckName("key", name);
        } else if (BecameStructured(value, adapted)) {
            fContext.GetOwnPlace().MakeLocal(adapted);
            fMetUnsettled = true;  // perhaps: the text names a class that may be declared later
        }
        TValueAccess::LimitDepth(adapted, TReferenceAdapter::kLevelsAbove);
        path.AddKeyValue(name, adapted);
    }
    if (path.GetKeyCount() < frame.keys.size()) {  // adding a key again replaces it
        fContext.Fail(EStatus::kParseError, "found a key a second time in one path, expected each once");
    }
    return path;
}

/// Gives the path the namespace and host that it is written with, unless they are the document's own.
void TCimXmlPathReader::SetPlace(TCIMReference& path, const TFrame& frame)
{
    const TOwnPlaceSearch::EAnswer answer = fContext.GetOwnPlace().Classify(frame.namespaceName, frame.host);
    if (answer != TOwnPlaceSearch::kOwn && !frame.namespaceName.empty()) {
        path.SetNamespaceName(frame.namespaceName);
        path.SetHost(frame.host);
    }
    fMetUnsettled = fMetUnsettled || answer == TOwnPlaceSearch::kOpen;
}

/// The key that a value without a name belongs to: the class must have exactly one.
const std::string& TCimXmlPathReader::FindOnlyKey(const TInMemClass* cls) const
{
    if (cls == nullptr || cls->GetLayout().GetKeys().size() != 1) {
        fContext.Fail(EStatus::kParseError, "found a key value without a name, expected it in a <KEYBINDING> that names the key"
                                            " (or a class with one key, declared in front of it)");
    }
    return cls->GetLayout().GetDecl(cls->GetLayout().GetKeys().front()).GetName();
}

/// References in a row are mostly to the same class, so the last one is compared before it is looked up.
boost::shared_ptr<TInMemClass> TCimXmlPathReader::FindClass(const std::string& name)
{
    if (!fNamespace || (fLastClass && fLastClass->GetName() == name)) {
        return fLastClass;
    }
    boost::shared_ptr<TInMemClass> cls = fNamespace->FindClass(name);
    if (cls) {
        fLastClass = cls;
    }
    return cls;
}

/// The name in front of an object is the outermost frame.
void TCimXmlPathReader::NoteOwnNamespace()
{
    const TFrame& frame = fFrames.front();
    if (fDepth > 0 && !frame.namespaceName.empty()) {
        fContext.NoteNamespace(frame.namespaceName, frame.host);
    }
}

void TCimXmlPathReader::CheckOwnClass(const char* className) const
{
    if (HasOwnPath() && !TNameText::Equal(fFrames.front().className, className)) {
        fContext.Fail(EStatus::kParseError, "found class " + Quote(className) + " behind the name of " +
                                                Quote(fFrames.front().className) + ", expected the same class in both");
    }
}

void TCimXmlPathReader::BeginNamespacePath()
{
    fNamespaceName.clear();
    fHost.clear();
}

/// Some writers give the whole name in one element, and a slash in front of it.
void TCimXmlPathReader::AddNamespace(const char* name)
{
    if (std::strpbrk(name, ":=\"") != nullptr) {
        fContext.Fail(EStatus::kParseError,
                      "found namespace " + Quote(name) + ", expected a name without colons, equals signs and quotes");
    }
    const std::string_view part = Trim(name, "/");
    if (!fNamespaceName.empty() && !part.empty()) {
        fNamespaceName += '/';
    }
    fNamespaceName += part;
}

void TCimXmlPathReader::SetHost(std::string_view host)
{
    if (!fHost.empty() || host.find('/') != std::string_view::npos) {
        fContext.Fail(EStatus::kParseError, "found host " + Quote(host) + ", expected one host, without a slash");
    }
    fHost = host;
}

void TCimXmlPathReader::EndNamespacePath()
{
    if (fDepth == 0) {
        fContext.NoteNamespace(fNamespaceName, fHost);
        return;
    }
    if (!fFrames[fDepth - 1].namespaceName.empty()) {
        fContext.Fail(EStatus::kParseError, "found a second namespace in one path, expected one");
    }
    fFrames[fDepth - 1].namespaceName = fNamespaceName;
    fFrames[fDepth - 1].host = fHost;
}

void TCimXmlPathReader::SetClassName(const char* name)
{
    if (!fFrames[fDepth - 1].className.empty()) {
        fContext.Fail(EStatus::kParseError, "found a second path where one is expected");
    }
    fFrames[fDepth - 1].className = name;
}

void TCimXmlPathReader::BeginKeyBinding(const char* name)
{
    fFrames[fDepth - 1].keyName = name;
    fFrames[fDepth - 1].isInBinding = true;
}

void TCimXmlPathReader::EndKeyBinding()
{
    TFrame& frame = fFrames[fDepth - 1];
    if (!frame.keyName.empty()) {
        fContext.Fail(EStatus::kParseError,
                      "found key " + Quote(frame.keyName) +
                          " without a value, expected a <KEYVALUE> or a <VALUE.REFERENCE> in its <KEYBINDING>");
    }
    frame.isInBinding = false;
}

void TCimXmlPathReader::BeginKeyValue(const TCimXmlAttributes& attributes)
{
    fValueType = attributes.Get("VALUETYPE");
    fType = attributes.Get("TYPE");
}

void TCimXmlPathReader::EndKeyValue(std::string_view text)
{
    AddKey(ReadKey(text));
}

void TCimXmlPathReader::AddKey(TCIMValue value)
{
    TFrame& frame = fFrames[fDepth - 1];
    if (frame.isInBinding && frame.keyName.empty()) {
        fContext.Fail(EStatus::kParseError, "found a second value in one <KEYBINDING>, expected one");
    }
    if (frame.keys.size() == TSchemaLimits::kMaxKeyBindings) {
        fContext.Fail(EStatus::kParseError,
                      "found more than " + std::to_string(TSchemaLimits::kMaxKeyBindings) + " key bindings in one path");
    }
    frame.keys.emplace_back(frame.keyName, std::move(value));
    frame.keyName.clear();
}

/// TYPE is exact, but newer than VALUETYPE, which many writers give alone. Without either, a key is text.
TCIMValue TCimXmlPathReader::ReadKey(std::string_view text)
{
    const TType type = TValueText::FindType(fType);
    if ((type == TType::kNone && (fValueType.empty() || fValueType == "string")) || type == TType::kString) {
        return fContext.GetTexts().MakeValue(text);
    }
    TCIMValue value;
    if (type != TType::kNone      ? TValueText::Parse(type, text, value)
        : fValueType == "boolean" ? TValueText::Parse(TType::kBoolean, text, value)
                                  : ReadNumber(text, value)) {
        return value;
    }
    const std::string expected = type != TType::kNone ? fType : fValueType == "boolean" ? "boolean" : "number";
    return SettleBadKey({0, fContext.GetTexts().MakeValue(text), std::string(text), expected, fContext.GetPlace()});
}

TCIMValue TCimXmlPathReader::SettleBadKey(const TBadValue& bad)
{
    const TFrame& frame = fFrames[fDepth - 1];
    if (fContext.GetOptions().badValues == EBadValues::kNull) {
        fContext.FailBadKey(bad, frame.className, frame.keyName);
    }
    fContext.NoteBadValue(bad, frame.className, frame.keyName, true);
    fContext.GetBadValues().NoteKey();
    return bad.value;
}

}  // namespace NORVZEL20
