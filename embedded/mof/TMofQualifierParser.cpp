// Qualifiers and their declarations:
//
//     list         "[" qualifier {, qualifier} "]"
//     qualifier    NAME [( element ) | array] [: FLAVOR {FLAVOR}]
//     declaration  qualifier NAME : TYPE ["[" [INTEGER] "]"] [= initializer] {, scope ( NAME {, NAME} ) | , flavor ( NAME {, NAME}
//     )} ;
//
// The declaration gives the type, the flavor and the value of what a qualifier leaves out.
#include "embedded/mof/TMofQualifierParser.h"

#include "embedded/load/MessageText.h"
#include "embedded/mof/TMofTypeParser.h"
#include "embedded/mof/TMofTyping.h"
#include "embedded/mof/TMofValueParser.h"
#include "embedded/store/TSchemaLimits.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

using TDecl = ICIMQualifierDecl;

struct TScopeWord {
    const char* word;
    unsigned int bits;
};

/// Schemas and qualifiers are no elements of a namespace.
constexpr TScopeWord kScopeWords[] = {{"any", TDecl::kScopeAny},
                                      {"class", TDecl::kScopeClass},
                                      {"association", TDecl::kScopeAssociation},
                                      {"indication", TDecl::kScopeIndication},
                                      {"property", TDecl::kScopeProperty},
                                      {"reference", TDecl::kScopeReference},
                                      {"method", TDecl::kScopeMethod},
                                      {"parameter", TDecl::kScopeParameter},
                                      {"schema", TDecl::kScopeNone},
                                      {"qualifier", TDecl::kScopeNone}};

struct TFlavorWord {
    const char* word;
    unsigned int set;
    unsigned int cleared;
};

constexpr TFlavorWord kFlavorWords[] = {
    {"EnableOverride", TDecl::kFlavorOverridable, 0}, {"DisableOverride", 0, TDecl::kFlavorOverridable},
    {"ToSubclass", TDecl::kFlavorToSubclass, 0},      {"Restricted", 0, TDecl::kFlavorToSubclass},
    {"ToInstance", TDecl::kFlavorToInstance, 0},      {"Translatable", TDecl::kFlavorTranslatable, 0}};

}  // namespace

TMofQualifierParser::TQualifiers TMofQualifierParser::ReadList()
{
    TQualifiers qualifiers;
    if (!fTokens.TakeSymbol('[')) {
        return qualifiers;
    }
    do {
        if (qualifiers.size() == TSchemaLimits::kMaxQualifiers) {
            fTokens.Fail("found more than " + std::to_string(TSchemaLimits::kMaxQualifiers) +
                         " qualifiers on one element; remove some");
        }
        const TLoadPlace place = fTokens.GetPlace();
        const TWritten written = ReadWritten(fTokens);
        const TLoadContext::TAt at(fTokens.GetContext(), place);
        qualifiers.push_back(Complete(written));
    } while (fTokens.TakeSymbol(','));
    fTokens.ExpectSymbol(']', "or , behind a qualifier");
    return qualifiers;
}

void TMofQualifierParser::Skip(TMofTokens& tokens)
{
    if (!tokens.TakeSymbol('[')) {
        return;
    }
    do {
        ReadWritten(tokens);
    } while (tokens.TakeSymbol(','));
    tokens.ExpectSymbol(']', "or , behind a qualifier");
}

TMofQualifierParser::TWritten TMofQualifierParser::ReadWritten(TMofTokens& tokens)
{
    TWritten written;
    written.name = tokens.ExpectName("the name of a qualifier");
    written.hasValue = tokens.IsSymbol('(') || tokens.IsSymbol('{');
    if (tokens.IsSymbol('{')) {
        written.value = TMofValueParser(tokens).ReadArray();
    } else if (tokens.TakeSymbol('(')) {
        written.value = TMofValueParser(tokens).ReadInitializer();
        tokens.ExpectSymbol(')', "behind the value of a qualifier");
    }
    if (tokens.TakeSymbol(':')) {
        do {
            AddFlavor(tokens, written.flavor);
        } while (tokens.Is(TMofToken::kName));
    }
    return written;
}

void TMofQualifierParser::AddFlavor(TMofTokens& tokens, TFlavor& flavor)
{
    for (const TFlavorWord& known : kFlavorWords) {
        if (!tokens.IsKeyword(known.word)) {
            continue;
        }
        flavor.set |= known.set;
        flavor.cleared |= known.cleared;
        if ((flavor.set & flavor.cleared) != 0) {
            tokens.Fail("found the flavor " + Quote(known.word) + " beside its opposite, expected one of the two");
        }
        return tokens.Advance();
    }
    tokens.FailExpected("a flavor: EnableOverride, DisableOverride, ToSubclass, Restricted or Translatable");
}

TEmbeddedObject::TQualifier TMofQualifierParser::Complete(const TWritten& written)
{
    const boost::shared_ptr<TInMemQualifierDecl> decl = fSink.FindQualifierDecl(written.name);
    if (!decl) {
        fHasMetUndeclared = true;
        return Guess(written);
    }
    const TCIMValue& declared = decl->GetValue();
    TEmbeddedObject::TQualifier qualifier;
    qualifier.name = written.name;
    qualifier.flavor = written.flavor.ChangeFrom(decl->GetFlavor(TCallContext()));
    if (written.hasValue) {
        qualifier.value =
            TMofTyping::ReadDeclared(fTokens.GetContext(), "qualifier " + Quote(written.name), written.value, declared.GetType());
    } else {
        qualifier.value = declared.GetType() == TCIMValue::TCIMType::kBoolean ? TCIMValue(true) : declared;
    }
    return qualifier;
}

TEmbeddedObject::TQualifier TMofQualifierParser::Guess(const TWritten& written)
{
    TEmbeddedObject::TQualifier qualifier;
    qualifier.name = written.name;
    qualifier.value = TCIMValue(true);
    qualifier.flavor = written.flavor.ChangeFrom(TDecl::kFlavorDefault);
    if (written.hasValue && !TMofTyping::Guess(written.value, TMofTyping::TResolve(), qualifier.value)) {
        fTokens.Fail("found " + TMofTyping::Describe(written.value) + " in qualifier " + Quote(written.name) +
                     ", expected elements of one type");
    }
    if (qualifier.value.GetType() == TCIMValue::TCIMType::kNone) {
        qualifier.value = TCIMValue::Null(TCIMValue::TCIMType::kString);
    }
    return qualifier;
}

TQualifierDraft TMofQualifierParser::ReadDecl()
{
    TQualifierDraft draft;
    draft.name = fTokens.ExpectName("the name of a qualifier");
    fTokens.ExpectSymbol(':', "behind the name of the qualifier");
    TCIMValue::TCIMType type = TMofTypeParser::ReadType(fTokens);
    unsigned int size = 0;
    type = TMofTypeParser::ReadArraySize(fTokens, type, size);
    draft.value = TCIMValue::Null(type);
    if (fTokens.TakeSymbol('=')) {
        const TMofValue value = TMofValueParser(fTokens).ReadInitializer();
        draft.value = TMofTyping::ReadDeclared(fTokens.GetContext(), "qualifier " + Quote(draft.name), value, type);
    }
    TFlavor flavor;
    while (fTokens.TakeSymbol(',')) {
        if (fTokens.TakeKeyword("scope")) {
            draft.scope = static_cast<TDecl::EScope>(draft.scope | ReadScope());
            continue;
        }
        fTokens.ExpectKeyword("flavor");
        fTokens.ExpectSymbol('(', "behind \"flavor\"");
        do {
            AddFlavor(fTokens, flavor);
        } while (fTokens.TakeSymbol(','));
        fTokens.ExpectSymbol(')', "or , behind a flavor");
    }
    draft.flavor = flavor.ChangeFrom(TDecl::kFlavorDefault);
    fTokens.ExpectSymbol(';', "behind the declaration of a qualifier");
    return draft;
}

unsigned int TMofQualifierParser::ReadScope()
{
    unsigned int scope = TDecl::kScopeNone;
    fTokens.ExpectSymbol('(', "behind \"scope\"");
    do {
        const TScopeWord* known = nullptr;
        for (const TScopeWord& word : kScopeWords) {
            known = fTokens.IsKeyword(word.word) ? &word : known;
        }
        if (known == nullptr) {
            fTokens.FailExpected("any, class, association, indication, property, reference, method or parameter");
        }
        scope |= known->bits;
        fTokens.Advance();
    } while (fTokens.TakeSymbol(','));
    fTokens.ExpectSymbol(')', "or , behind an element of a scope");
    return scope;
}

}  // namespace NORVZEL20
