#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <string>

#include "tests/support/TNamespaceBuilder.h"

namespace NORVZEL20 {

/// Small namespaces that differ in every way that a run records.

/// What keeps a run over them from its end.
enum class EFlaw {
    kNone,
    kNoSlots,          ///< the last namespace lacks the class Slot: status 37 after the records of disks
    kNoUplinkOfSlots,  ///< its slots lack the property Uplink: status 15, the host's answer, after the same records
    kUnknownProperty,  ///< the specification names a property that nothing has: status 9 before any record
};

/// Declares the classes Disk, Ssd (below Disk), Slot and, in namespace 0 alone, Ghost, and fills them as namespace `index` has
/// them. Of the flaws, those of a namespace count.
void FillDiffering(TNamespaceBuilder& builder, std::size_t index, EFlaw flaw = EFlaw::kNone);

/// The same classes, as namespace 0 has them, filled like `reference`, whatever runs have made of it.
void FillLike(TNamespaceBuilder& builder, boost::shared_ptr<ICIMNamespace> reference);

/// A specification that compares all of it but the notes of disks and the size of solid ones; with excluded keys, slots are matched
/// by their number whatever their bus and shelf. Each element `class` stands on a line of its own.
std::string RulesForDiffering(bool excludesKeys, EFlaw flaw = EFlaw::kNone);

/// What the namespace has of each class, as text.
std::string DumpDiffering(boost::shared_ptr<ICIMNamespace> ns);

}  // namespace NORVZEL20
