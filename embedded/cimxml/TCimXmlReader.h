#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "embedded/cimxml/TCimXmlContext.h"
#include "embedded/cimxml/TCimXmlDraftBuilder.h"
#include "embedded/cimxml/TCimXmlLoader.h"
#include "embedded/cimxml/TCimXmlPathReader.h"
#include "embedded/cimxml/TCimXmlTable.h"
#include "embedded/cimxml/TXmlReader.h"

namespace NORVZEL20 {

/// Reads CIM-XML: walks TCimXmlTable by the XML events and does the actions it names.
///
/// Qualifier declarations, classes and instances go to the loader, those instances that it can fill directly property by property.
/// Without a loader, the text is that of an embedded object, which TakeObject gives.
/// Errors: the context's, thrown from the events.
class TCimXmlReader : public TXmlReader::ISink {
  public:
    /// `ns` (may be null) is where the classes of references are looked up.
    TCimXmlReader(TCimXmlContext& context, boost::shared_ptr<TInMemNamespace> ns, TCimXmlLoader* loader);
    ~TCimXmlReader() override;

    void OnStart(const char* name, const char** attributes) override;
    void OnEnd(const char* name) override;
    void OnText(const char* text, std::size_t length) override { fText = std::string_view(text, length); }

    /// The value with those of its texts read that are embedded objects, for a property that its declaration says holds such.
    TCIMValue ReadObjects(const TCIMValue& value);

    /// Starts over, for another embedded object.
    void Reset();
    /// The embedded object that was read. Errors: fails with status 13 where there is none.
    boost::shared_ptr<const TEmbeddedObject> TakeObject();

  private:
    class TEmbedded;
    using TTable = TCimXmlTable;
    using TElement = TCimXmlElement;

    struct TOpen {
        TTable::EState state;
        TElement::EElement element;
    };

    /// What has a value: a property, a qualifier or a qualifier's declaration.
    struct TItem {
        enum EText { kPlain, kObject, kPerhapsObject };

        std::string_view name;  // kept by whoever declares it, for a qualifier in fQualifierName
        TCIMValue::TCIMType type = TCIMValue::TCIMType::kNone;
        EText text = kPlain;
        bool isGiven = false;
        TCIMValue value;
    };

    [[noreturn]] void FailUnexpected(const char* name) const;
    void CheckBlank() const;
    const char* Require(const TCimXmlAttributes& attributes, const char* name) const;
    TCIMValue::TCIMType ReadType(const char* text) const;
    TTable::EState GetState() const noexcept { return fOpen.back().state; }

    void Begin(TTable::EAction action, const TCimXmlAttributes& attributes);
    void BeginDeclared(TTable::EAction action, const TCimXmlAttributes& attributes);
    void End(TTable::EAction action);
    void EndDeclared(TTable::EAction action);

    void BeginObject();
    void EndObject();
    void NoteObject();
    void BeginClass(const TCimXmlAttributes& attributes);
    void EndClass();
    void BeginInstance(const TCimXmlAttributes& attributes);
    void EndInstance();
    void BeginProperty(const TCimXmlAttributes& attributes);
    TCIMValue::TCIMType ReadPropertyType(const TCimXmlAttributes& attributes) const;
    void EndProperty();
    void BeginMethod(const TCimXmlAttributes& attributes);
    void BeginParameter(const TCimXmlAttributes& attributes);
    void BeginQualifier(const TCimXmlAttributes& attributes);
    void EndQualifier();
    void BeginQualifierDecl(const TCimXmlAttributes& attributes);
    void ReadScope(const TCimXmlAttributes& attributes);
    void EndQualifierDecl();
    void ReadError(const TCimXmlAttributes& attributes) const;
    void NoteSkipped();

    void BeginItem(TItem& item, std::string_view name, TCIMValue::TCIMType type);
    void BeginValue();
    void EndText();
    void EndReference();
    void BeginArray();
    void EndArray();
    void MakeValue(std::string_view text, TCIMValue& value);
    bool IsObject(std::string_view text) const;
    TCIMValue MakeObject(std::string_view text);
    TCIMValue TakeValue(TItem& item);

    TCimXmlContext& fContext;
    boost::shared_ptr<TInMemNamespace> fNamespace;
    TCimXmlLoader* fLoader;
    TCimXmlPathReader fPaths;
    TCimXmlDraftBuilder fDraft;
    std::vector<TOpen> fOpen;
    std::string_view fText;
    TItem fProperty;
    TItem fQualifier;
    std::string fQualifierName;
    TItem* fItem = nullptr;
    std::vector<TCIMValue> fElements;
    TCimXmlLoader::TTarget fTarget{nullptr, 0, TCIMValue::TCIMType::kNone, false};
    bool fDirect = false;       // the instance is filled without a draft
    bool fObjectGiven = false;  // the VALUE.OBJECT that is open has had its class or instance
    ICIMQualifierDecl::EFlavor fFlavor = ICIMQualifierDecl::kFlavorDefault;
    unsigned int fScope = 0;
    bool fPropagated = false;
    boost::shared_ptr<const TEmbeddedObject> fObject;
    std::unique_ptr<TEmbedded> fEmbedded;
};

}  // namespace NORVZEL20
