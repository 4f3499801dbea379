#pragma once

#include <string>

#include "embedded/load/TLoadReport.h"
#include "embedded/store/TOwnPlace.h"
#include "embedded/value/TNameText.h"
#include "host/Export.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

/// Knows which references stay within the document's own namespace, and takes that namespace out of them.
///
/// Until Decide is called, some references are open: what the rest of the document names decides about them. They keep their
/// namespace and host, and have to be passed to MakeLocal again after Decide.
/// Threads: one at a time, as the load that it belongs to.
class CIMDELTA_INTERNAL_EXPORT TOwnPlaceSearch {
  public:
    enum EAnswer : unsigned char {
        kOwn,
        kForeign,
        kOpen  ///< not known before Decide
    };

    /// `report` says what the document names for itself so far. It must outlive this.
    explicit TOwnPlaceSearch(TLoadReport& report) noexcept : fReport(report) {}

    /// Whose a path with that namespace and host (both may be empty) is. Notes what Decide needs. A path without a namespace is
    /// kForeign, since there is nothing to take out of it.
    EAnswer Classify(const std::string& name, const std::string& host);
    /// Takes the own namespace and host out of the references in `value`, out of those in their keys, in arrays and in embedded
    /// objects. Returns whether one of them is open.
    bool MakeLocal(TCIMValue& value);

    /// Whether all references that name a namespace name one and the same, and others name none.
    bool IsMixed() const noexcept { return fIsAnyNameless && fNamed.size() == 1; }
    /// Whether any reference has been open.
    bool HasOpen() const noexcept { return !fNamed.empty(); }
    /// Decides about the open references. Call it when the document has ended and all its references have been classified. Gives
    /// the report the namespace if the document names none itself. `leadsHere` says whether an open reference leads to an instance
    /// of the document; it matters if IsMixed.
    void Decide(bool leadsHere);
    /// The place that the document has named so far, or that was decided on.
    TOwnPlace GetNamed() const;

  private:
    /// The hosts that open references name beside one namespace.
    struct THosts {
        std::string first;  // empty if there is none
        bool areSeveral = false;
    };

    bool MakePathLocal(TCIMValue& value, bool& isOpen);

    TLoadReport& fReport;
    TNameMap<THosts> fNamed;      // by namespace
    bool fIsAnyNameless = false;  // whether a reference names no namespace
    bool fIsDecided = false;
    bool fIsAnyHostOwn = false;  // the references name one host at most, and the document names none
};

}  // namespace NORVZEL20
