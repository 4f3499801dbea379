#include "embedded/TCimXmlPathReader.h"

#include "embedded/TNameText.h"
#include "embedded/TSchemaLimits.h"
#include "embedded/TValueText.h"

namespace NORVZEL20 {

namespace {

using EStatus = TZELStatusCode::EStatusCode;
using TType = TCIMValue::TCIMType;

/// A number whose type the document does not tell.
bool ReadNumber(std::string_view text, TCIMValue& value)
{
    return TValueText::Parse(TType::kUint64, text, value) || TValueText::Parse(TType::kSint64, text, value) ||
           TValueText::Parse(TType::kReal64, text, value);
}

}  // namespace

TCimXmlPathReader::TCimXmlPathReader(TCimXmlContext& context, boost::shared_ptr<TInMemNamespace> ns)
    : fContext(context), fNamespace(std::move(ns)), fFrames(1)
{}

void TCimXmlPathReader::Begin()
{
    if (++fDepth > fFrames.size())
        fFrames.emplace_back();
    TFrame& frame = fFrames[fDepth - 1];
    frame.namespaceName.clear();
    frame.host.clear();
    frame.className.clear();
    frame.keyName.clear();
    frame.keys.clear();
}

TCIMReference TCimXmlPathReader::End()
{
    const TFrame& frame = fFrames[--fDepth];
    if (frame.className.empty())
        fContext.Fail(EStatus::kParseError, "found an empty <VALUE.REFERENCE>, expected the name of a class or an instance in it");
    TCIMReference path;
    const boost::shared_ptr<TInMemClass> cls = FindClass(frame.className);
    if (cls) {
        path.SetClass(cls);
    } else {
        path.SetClassName(frame.className);
        fMetUnknownClass = true;
    }
    if (!frame.namespaceName.empty() && !fContext.IsOwn(frame.namespaceName, frame.host)) {
        path.SetNamespaceName(frame.namespaceName);
        path.SetHost(frame.host);
    }
    for (const auto& [declared, value] : frame.keys) {
        std::string name = declared.empty() ? FindOnlyKey(cls.get()) : declared;
        const TCIMValue adapted = cls ? Adapt(*cls, name, value) : value;
        path.AddKeyValue(name, adapted);
    }
    return path;
}

/// The value in the declared type of the key where that loses nothing; the name in its declared spelling.
TCIMValue TCimXmlPathReader::Adapt(const TInMemClass& cls, std::string& name, const TCIMValue& value) const
{
    const std::uint32_t slot = cls.FindSlot(name);
    if (slot == TInMemClass::kNoSlot)
        return value;
    const TInMemPropertyDecl& decl = cls.GetSlotDecl(slot);
    name = decl.GetName();
    TCIMValue adapted;
    return value.GetType() != decl.GetType() && TValueText::Convert(value, decl.GetType(), adapted) ? adapted : value;
}

/// The key that a value without a name belongs to.
const std::string& TCimXmlPathReader::FindOnlyKey(const TInMemClass* cls) const
{
    if (cls == nullptr || cls->GetKeySlots().size() != 1)
        fContext.Fail(EStatus::kParseError, "found a key value without a name, expected it in a <KEYBINDING> that names the key");
    return cls->GetSlotDecl(cls->GetKeySlots().front()).GetName();
}

boost::shared_ptr<TInMemClass> TCimXmlPathReader::FindClass(const std::string& name)
{
    if (!fNamespace || (fLastClass && fLastClass->GetName() == name))
        return fLastClass;
    boost::shared_ptr<TInMemClass> cls = fNamespace->FindClass(name);
    if (cls)
        fLastClass = cls;
    return cls;
}

void TCimXmlPathReader::NoteOwnNamespace()
{
    const TFrame& frame = fFrames.front();
    if (fDepth > 0 && !frame.namespaceName.empty())
        fContext.NoteNamespace(frame.namespaceName, frame.host);
}

void TCimXmlPathReader::BeginNamespacePath()
{
    fNamespaceName.clear();
    fHost.clear();
}

void TCimXmlPathReader::AddNamespace(const char* name)
{
    if (!fNamespaceName.empty())
        fNamespaceName += '/';
    fNamespaceName += name;
}

void TCimXmlPathReader::SetHost(std::string_view host)
{
    fHost = host;
}

void TCimXmlPathReader::EndNamespacePath()
{
    if (fDepth == 0) {
        fContext.NoteNamespace(fNamespaceName, fHost);
        return;
    }
    fFrames[fDepth - 1].namespaceName = fNamespaceName;
    fFrames[fDepth - 1].host = fHost;
}

void TCimXmlPathReader::SetClassName(const char* name)
{
    fFrames[fDepth - 1].className = name;
}

void TCimXmlPathReader::BeginKeyBinding(const char* name)
{
    fFrames[fDepth - 1].keyName = name;
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
    if (frame.keys.size() == TSchemaLimits::kMaxKeyBindings)
        fContext.Fail(EStatus::kParseError,
                      "found more than " + std::to_string(TSchemaLimits::kMaxKeyBindings) + " key bindings in one path");
    frame.keys.emplace_back(frame.keyName, std::move(value));
    frame.keyName.clear();
}

TCIMValue TCimXmlPathReader::ReadKey(std::string_view text)
{
    const TType type = TValueText::FindType(fType);
    if ((type == TType::kNone && (fValueType.empty() || fValueType == "string")) || type == TType::kString)
        return fContext.GetTexts().MakeValue(text);
    TCIMValue value;
    if (type != TType::kNone      ? TValueText::Parse(type, text, value)
        : fValueType == "boolean" ? TValueText::Parse(TType::kBoolean, text, value)
                                  : ReadNumber(text, value))
        return value;
    const std::string expected = type != TType::kNone ? fType : fValueType == "boolean" ? "boolean" : "number";
    fContext.Fail(EStatus::kTypeMismatch,
                  "found " + TCimXmlContext::Quote(text) + " as the value of a key, expected a " + expected);
}

}  // namespace NORVZEL20
