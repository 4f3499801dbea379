#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>
#include <string_view>
#include <vector>

#include "embedded/cimxml/IXmlSink.h"
#include "embedded/cimxml/TCimXmlAnswerReader.h"
#include "embedded/cimxml/TCimXmlAttributes.h"
#include "embedded/cimxml/TCimXmlDraftBuilder.h"
#include "embedded/cimxml/TCimXmlItem.h"
#include "embedded/cimxml/TCimXmlObjectReader.h"
#include "embedded/cimxml/TCimXmlPathReader.h"
#include "embedded/cimxml/TCimXmlPropertyReader.h"
#include "embedded/cimxml/TCimXmlQualifierReader.h"
#include "embedded/cimxml/TCimXmlTable.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/load/TLoader.h"

namespace NORVZEL20 {

/// Reads CIM-XML: turns XML events into the actions of TCimXmlTable and carries them out.
///
/// Qualifier declarations, classes and instances go to the loader. A reader without a loader reads the text of one embedded object,
/// which TakeObject then returns.
/// Errors: the events fail through the context, with kParseError (9) for what the table does not accept.
class TCimXmlReader : public IXmlSink {
  public:
    /// The classes of references are looked up in `ns` (may be null). `context` and `loader` (may be null) must outlive the reader.
    /// `parser` reads the texts of embedded objects.
    TCimXmlReader(TLoadContext& context, const boost::shared_ptr<const TInMemNamespace>& ns, TLoader* loader,
                  TXmlReader::EParser parser);

    void OnStart(const char* name, const char** attributes) override;
    void OnKnownStart(std::size_t number, const char* name, const char** attributes) override;
    void OnEnd(const char* name) override;
    void OnText(const char* text, std::size_t length) override { fText = std::string_view(text, length); }

    /// Makes the reader ready for another document.
    void Reset();
    /// The innermost element that is open; empty if none is.
    const char* GetOpenElement() const noexcept { return fOpen.size() > 1 ? TElement::GetName(fOpen.back().element) : ""; }
    /// The embedded object that was read; null if the document did not end. Each is returned once.
    boost::shared_ptr<const TEmbeddedObject> TakeObject() noexcept;
    /// See TCimXmlPathReader::TakeMetUnsettled.
    bool TakeMetUnsettled() noexcept { return fPaths.TakeMetUnsettled(); }

  private:
    using TTable = TCimXmlTable;
    using TElement = TCimXmlElement;

    struct TOpen {
        TTable::EState state;
        TElement::EElement element;
    };

    [[noreturn]] void FailUnexpected(const char* name) const;
    /// If only elements may stand here, the text must be white space.
    void CheckBlank() const
    {
        // Between two tags, there is mostly nothing or one line feed.
        const bool isLineFeed = fText.size() == 1 && fText.front() == '\n';
        if (!fText.empty() && !isLineFeed && !TTable::TakesText(GetState())) {
            RequireBlank();
        }
    }
    void RequireBlank() const;
    TTable::EState GetState() const noexcept { return fOpen.back().state; }
    TTable::EState GetOuterState() const noexcept { return fOpen[fOpen.size() - 2].state; }

    TTable::EAction Enter(const char* name, TElement::EElement element);
    void Begin(TTable::EAction action, const TCimXmlAttributes& attributes);
    void BeginRare(TTable::EAction action, const TCimXmlAttributes& attributes);
    void End(TTable::EAction action);
    void EndRare(TTable::EAction action);

    void BeginObject();
    void EndObject();
    void NoteObject(const char* className);
    void BeginClass(const TCimXmlAttributes& attributes);
    void EndClass();
    void BeginInstance(const TCimXmlAttributes& attributes);
    void EndInstance();
    bool KeepObject(TDraft& draft);
    void EndQualifier();
    void BeginValue();
    void EndText();
    void EndReference();

    TLoadContext& fContext;
    TLoader* fLoader;
    TCimXmlPathReader fPaths;
    TCimXmlObjectReader fObjects;
    TCimXmlDraftBuilder fDraft;
    TCimXmlAnswerReader fAnswer;
    TCimXmlPropertyReader fProperty;
    TCimXmlQualifierReader fQualifier;
    TCimXmlItem* fItem = &fProperty.GetItem();  // what a value belongs to: the property, or the qualifier that is open
    std::vector<TOpen> fOpen;                   // the open elements, outermost first
    std::string_view fText;                     // between the last tag and this one
    bool fIsDirect = false;                     // the instance is filled without a draft
    bool fIsObjectGiven = false;                // the VALUE.OBJECT that is open has had its class or instance
    boost::shared_ptr<const TEmbeddedObject> fObject;
    const std::uint64_t fFirstTag;           // added to the numbers of known tags, which each document begins anew
    std::vector<TElement::EElement> fKnown;  // the elements of known tags, by their numbers; kCount if it has not been looked up
};

}  // namespace NORVZEL20
