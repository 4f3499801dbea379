#pragma once

#include <cstddef>

#include "embedded/cimxml/TCimXmlAttributes.h"
#include "embedded/cimxml/TCimXmlContext.h"
#include "embedded/cimxml/TCimXmlDraftBuilder.h"
#include "embedded/cimxml/TCimXmlItem.h"
#include "embedded/cimxml/TCimXmlLoader.h"
#include "embedded/cimxml/TCimXmlPathReader.h"
#include "embedded/cimxml/TCimXmlTarget.h"

namespace NORVZEL20 {

/// Reads property elements: for an instance that the loader is filling, straight into its slot, and otherwise into a draft.
///
/// Order of calls: one of the operations that begin, then the value goes to the item, then the End that belongs to it.
/// Errors: every operation fails through the context.
class TCimXmlPropertyReader {
  public:
    /// All arguments must outlive the reader. `loader` may be null if no instance is filled directly.
    TCimXmlPropertyReader(TCimXmlContext& context, TCimXmlObjectReader& objects, TCimXmlLoader* loader, TCimXmlPathReader& paths,
                          TCimXmlDraftBuilder& draft) noexcept
        : fContext(context), fLoader(loader), fPaths(paths), fDraft(draft), fItem(context, objects)
    {}

    /// What the property's value goes to.
    TCimXmlItem& GetItem() noexcept { return fItem; }

    /// Begins a property of a draft.
    void BeginInDraft(const TCimXmlAttributes& attributes);
    void EndInDraft() { fDraft.EndProperty(fItem.Take()); }

    /// Begins a property of the instance that the loader is filling. Errors: see TCimXmlInstanceBuilder::FindProperty.
    void BeginInInstance(const TCimXmlAttributes& attributes);
    /// The same for a tag with a number (see IXmlSink::OnKnownStart): what was found out for it before is not looked up again.
    void BeginInInstance(std::size_t number, const TCimXmlAttributes& attributes);
    void EndInInstance();

  private:
    using TType = TCIMValue::TCIMType;

    static TCimXmlItem::EText GetText(const TCimXmlAttributes& attributes, TType type, bool isDeclaredEmbedded);
    static TType ReadType(const TCimXmlAttributes& attributes, TType declared);

    TCimXmlContext& fContext;
    TCimXmlLoader* fLoader;
    TCimXmlPathReader& fPaths;
    TCimXmlDraftBuilder& fDraft;
    TCimXmlItem fItem;
    TCimXmlTarget* fTarget = nullptr;  // the property of an instance that was begun last
};

}  // namespace NORVZEL20
