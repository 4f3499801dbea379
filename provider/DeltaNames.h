#pragma once

#include <cstdint>

/// The names and bounds that the plug-in shares with its clients: with those that prepare a run and those that read its records.

namespace NORVZEL20 {

/// The name under which the provider manager finds the plug-in.
inline constexpr char kDeltaProviderName[] = "delta";

/// The call context's entry that selects a compared namespace by its position, counted from 0.
inline constexpr char kNamespaceIndexEntry[] = "nsIndex";

/// The record of a class with differences.
inline constexpr char kClassRecord[] = "KALMO_DeltaClass";
inline constexpr char kClassRecordName[] = "ClassName";  ///< string: the class's name

/// The record of one difference.
inline constexpr char kDeltaRecord[] = "KALMO_Delta";
inline constexpr char kDeltaRecordType[] = "Type";                 ///< uint8: a TDeltaNamespace::EDeltaType
inline constexpr char kDeltaRecordInstance[] = "InstanceName";     ///< string: the key text or path of the instance
inline constexpr char kDeltaRecordProperty[] = "Property";         ///< string: the property; empty if a whole instance differs
inline constexpr char kDeltaRecordIndices[] = "NamespaceIndices";  ///< uint16[]: the positions of the namespaces concerned

/// The association of a class's record with the record of one of its differences.
inline constexpr char kDeltaAssociation[] = "KALMO_DeltaClassAssocToDelta";
inline constexpr char kDeltaAssociationClass[] = "Class";  ///< reference to the class's record
inline constexpr char kDeltaAssociationDelta[] = "Delta";  ///< reference to the difference's record

/// The class that each compared namespace must have. The reference also needs an instance of it.
inline constexpr char kOperatingSystemClass[] = "KALMO_OperatingSystem";
inline constexpr char kOperatingSystemType[] = "OSType";  ///< uint16: a run needs that of the reference

/// The property that is not compared in a class whose default is to include. If the default is to exclude, a list may include it.
inline constexpr char kCollectionTime[] = "DateTimeOfCollection";

/// A specification file with this text in its name is not read: the run has no rules.
inline constexpr char kNoRulesMarker[] = "|fVMWareEnable";

/// The size in bytes of the largest specification file that is read.
inline constexpr std::uint64_t kMaxSpecFileSize = 104857600;

}  // namespace NORVZEL20
