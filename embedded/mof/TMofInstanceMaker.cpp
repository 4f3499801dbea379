// Instances, with types.
//
// Embedded objects come in two forms: as an instance that stands as a value, and as a text that is itself MOF, in a property that
// is declared to hold objects. Both become the same object. Text that does not begin like MOF stays as it is: the loader reads it
// if it is CIM-XML. An object has the properties that are written and no defaults, as in CIM-XML.
#include "embedded/mof/TMofInstanceMaker.h"

#include <boost/smart_ptr/make_shared.hpp>
#include <utility>

#include "embedded/load/AsText.h"
#include "embedded/load/MessageText.h"
#include "embedded/load/ReadEachText.h"
#include "embedded/mof/TMofClassParser.h"
#include "embedded/mof/TMofTokens.h"
#include "embedded/mof/TMofValueParser.h"
#include "embedded/store/TInMemClass.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

/// Whether the text begins with a word of MOF that begins an object, and goes on with something else.
bool IsPerhapsMof(std::string_view text)
{
    const std::size_t begin = text.find_first_not_of(" \t\r\n");
    if (begin == std::string_view::npos) {
        return false;
    }
    const std::string_view rest = text.substr(begin);
    const std::size_t end = rest.find_first_of(" \t\r\n");
    return end != std::string_view::npos &&
           (TNameText::Equal(rest.substr(0, end), "instance") || TNameText::Equal(rest.substr(0, end), "class"));
}

const TInMemPropertyDecl* FindDecl(const TInMemClass* cls, const std::string& name)
{
    const std::uint32_t slot = cls != nullptr ? cls->GetLayout().FindSlot(name.c_str()) : TInMemLayout::kNoSlot;
    return slot != TInMemLayout::kNoSlot ? &cls->GetLayout().GetDecl(slot) : nullptr;
}

}  // namespace

TMofInstanceMaker::TMofInstanceMaker(TLoadContext& context, const TInMemNamespace& ns, IMofSink& sink,
                                     const std::vector<const TMofInstance*>& instances)
    : fContext(context), fNamespace(ns), fSink(sink), fResolve([this](const TMofValue& value) { return Resolve(value); }),
      fAliases(context, ns, instances, fResolve)
{}

TDraft TMofInstanceMaker::Make(const TMofInstance& instance)
{
    const boost::shared_ptr<TInMemClass> cls = fNamespace.FindClass(instance.className);
    TDraft draft{TEmbeddedObject(instance.className), instance.place, {}, {}};
    draft.takesDefaults = true;
    for (const TMofInstance::TProperty& property : instance.properties) {
        const TLoadContext::TAt at(fContext, property.place);
        TEmbeddedObject::TProperty made;
        made.name = property.name;
        std::optional<TBadValue> bad;
        made.value = ReadValue(FindDecl(cls.get(), property.name), property, bad);
        if (bad) {
            bad->property = draft.object.GetProperties().size();
            draft.badValues.push_back(std::move(*bad));
        }
        draft.object.AddProperty(std::move(made));
        draft.propertyPlaces.push_back(property.place);
    }
    return draft;
}

/// A value that does not fit its type is passed on with the type that its form suggests: the loader converts or refuses it.
/// If there is a bad value, what is returned is NULL.
TCIMValue TMofInstanceMaker::ReadValue(const TInMemPropertyDecl* decl, const TMofInstance::TProperty& property,
                                       std::optional<TBadValue>& bad)
{
    TCIMValue value;
    if (decl != nullptr && TMofTyping::Read(property.value, decl->GetType(), fResolve, value)) {
        return decl->HoldsObjects() ? ReadObjects(value, bad) : value;
    }
    if (!TMofTyping::Guess(property.value, fResolve, value)) {
        fContext.Fail(TZELStatusCode::kTypeMismatch, "found " + TMofTyping::Describe(property.value) + " in property " +
                                                         Quote(property.name) + ", expected elements of one type");
    }
    return value;
}

TCIMValue TMofInstanceMaker::Resolve(const TMofValue& value)
{
    if (value.kind == TMofValue::kAlias) {
        return fAliases.GetReference(value.text);
    }
    const TLoadContext::TEmbedded embedded(fContext);
    return TCIMValue(boost::shared_ptr<const TEmbeddedObject>(boost::make_shared<TEmbeddedObject>(MakeObject(*value.object))));
}

TEmbeddedObject TMofInstanceMaker::MakeObject(const TMofInstance& instance)
{
    const boost::shared_ptr<TInMemClass> cls = fNamespace.FindClass(instance.className);
    TEmbeddedObject object(instance.className);
    for (const TMofInstance::TProperty& property : instance.properties) {
        TEmbeddedObject::TProperty made;
        made.name = property.name;
        std::optional<TBadValue> bad;
        made.value = ReadValue(FindDecl(cls.get(), property.name), property, bad);
        if (bad) {
            fContext.NoteBadValue(*bad, instance.className, property.name, true);
            made.value = fContext.GetOptions().badValues == EBadValues::kText ? bad->value : made.value;
        }
        object.AddProperty(std::move(made));
    }
    return object;
}

/// The message of a load that refuses the text is about what is wrong inside of it.
TCIMValue TMofInstanceMaker::ReadObjects(const TCIMValue& value, std::optional<TBadValue>& bad)
{
    const std::size_t mark = fContext.GetBadValues().GetMark();
    try {
        return ReadElements(value);
    } catch (const TPopulateError& error) {
        if (!fContext.LetsPass(error)) {
            fContext.RefuseObject(error);
        }
    }
    fContext.GetBadValues().TakeBack(mark);
    bad = TBadValue{0, AsText(value), value.ToText(), "class or instance", fContext.GetPlace()};
    return TCIMValue::Null(value.GetType());
}

TCIMValue TMofInstanceMaker::ReadElements(const TCIMValue& value)
{
    return ReadEachText(value, [this](const TCIMValue& text) {
        if (!IsPerhapsMof(text.GetString())) {
            return text;
        }
        const TLoadContext::TEmbedded embedded(fContext);
        return TCIMValue(ReadObjectText(text.GetString()));
    });
}

/// The semicolon behind an object may be missing.
boost::shared_ptr<const TEmbeddedObject> TMofInstanceMaker::ReadObjectText(std::string_view text)
{
    TMofTokens tokens(fContext, text);
    tokens.Advance();
    boost::shared_ptr<TEmbeddedObject> object;
    if (tokens.TakeKeyword("class")) {
        object = boost::make_shared<TEmbeddedObject>(TMofClassParser(tokens, fSink).Read(fContext.GetPlace()).object);
    } else {
        tokens.ExpectKeyword("instance");
        object = boost::make_shared<TEmbeddedObject>(MakeObject(TMofValueParser(tokens).ReadInstance(fContext.GetPlace())));
        tokens.TakeSymbol(';');
    }
    if (!tokens.Is(TMofToken::kEnd)) {
        tokens.FailExpected("the end of the embedded object");
    }
    return object;
}

}  // namespace NORVZEL20
