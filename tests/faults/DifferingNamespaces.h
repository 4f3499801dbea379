#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <string>

#include "tests/support/TNamespaceBuilder.h"

namespace NORVZEL20 {

/// Small namespaces that differ in every way that a run records.

/// A flaw that makes a run over them fail.
enum class EFlaw {
    kNone,
    kNoSlots,          ///< the last namespace lacks the class Slot: kSchemaMismatch (37) after the records of disks
    kNoUplinkOfSlots,  ///< its slots lack the property Uplink: kNotFound (15) of the host after the same records
    kUnknownProperty,  ///< the specification names an unknown property: kParseError (9) before any record
};

/// Declares the classes Disk, Ssd (below Disk), Slot and, in namespace 0 only, Ghost, and adds the instances of namespace `index`.
/// Flaws of the rules are ignored here.
void FillDiffering(TNamespaceBuilder& builder, std::size_t index, EFlaw flaw = EFlaw::kNone);

/// Declares the classes of namespace 0 and copies all instances of `reference`, including what runs have changed in them.
void FillLike(TNamespaceBuilder& builder, boost::shared_ptr<ICIMNamespace> reference);

/// A specification that compares everything except Disk.Note and Ssd.Size. With excluded keys, slots are matched by their number
/// alone. Each element `class` is on its own line.
std::string RulesForDiffering(bool excludesKeys, EFlaw flaw = EFlaw::kNone);

/// The instances of each class, as text.
std::string DumpDiffering(boost::shared_ptr<ICIMNamespace> ns);

}  // namespace NORVZEL20
