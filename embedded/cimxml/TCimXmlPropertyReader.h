#pragma once

#include "embedded/cimxml/TCimXmlAttributes.h"
#include "embedded/cimxml/TCimXmlDraftBuilder.h"
#include "embedded/cimxml/TCimXmlItem.h"
#include "embedded/cimxml/TCimXmlPathReader.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/load/TLoadTarget.h"
#include "embedded/load/TLoader.h"

namespace NORVZEL20 {

/// Reads property elements: for an instance that the loader is filling, straight into its slot, and otherwise into a draft.
///
/// Order of calls: one of the operations that begin, then the value goes to the item, then the End that belongs to it.
/// Errors: every operation fails through the context.
class TCimXmlPropertyReader {
  public:
    /// All arguments must outlive the reader. `loader` may be null if no instance is filled directly.
    TCimXmlPropertyReader(TLoadContext& context, TCimXmlObjectReader& objects, TLoader* loader, TCimXmlPathReader& paths,
                          TCimXmlDraftBuilder& draft) noexcept
        : fContext(context), fLoader(loader), fPaths(paths), fDraft(draft), fItem(context, objects)
    {}

    /// What the property's value goes to.
    TCimXmlItem& GetItem() noexcept { return fItem; }

    /// Begins a property of a draft.
    void BeginInDraft(const TCimXmlAttributes& attributes);
    void EndInDraft();

    /// Begins a property of the instance that the loader is filling. Errors: see TInstanceBuilder::FindProperty.
    void BeginInInstance(const TCimXmlAttributes& attributes);
    /// The same for a tag with a number (see IXmlSink::OnKnownStart): what was found out for it before is not looked up again.
    void BeginInInstance(std::uint64_t number, const TCimXmlAttributes& attributes);
    void EndInInstance();

  private:
    using TType = TCIMValue::TCIMType;

    void EndBad();
    TCIMValue SettleInDraft(TBadValue bad);
    static EValueText GetText(const TCimXmlAttributes& attributes, TType type, bool isDeclaredEmbedded);
    static TType ReadType(const TCimXmlAttributes& attributes, TType declared);

    TLoadContext& fContext;
    TLoader* fLoader;
    TCimXmlPathReader& fPaths;
    TCimXmlDraftBuilder& fDraft;
    TCimXmlItem fItem;
    TLoadTarget* fTarget = nullptr;  // the property of an instance that was begun last
};

}  // namespace NORVZEL20
