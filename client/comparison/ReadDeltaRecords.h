#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <map>
#include <string>
#include <vector>

#include "client/comparison/TDeltaRecord.h"
#include "host/ICIMInstance.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Instances of KALMO_Delta.
using TDeltaInstances = std::vector<boost::shared_ptr<ICIMInstance>>;

/// The records of a delta namespace by the name of their class, in the order in which they were written.
///
/// Reads with ExecuteQuery and GetInstance alone, as any client of the host could. Errors: TZELException of the namespace.
std::map<std::string, TDeltaInstances> CollectDeltaRecords(TDeltaNamespace& ns);

/// The whole record. Errors: TZELException of the namespace.
TDeltaRecord ReadDeltaRecord(const ICIMInstance& delta);

/// Parts of a record. The texts are shared with it. Errors: TZELException of the namespace.
TDeltaNamespace::EDeltaType TypeOfRecord(const ICIMInstance& delta);
TCIMValue InstanceOfRecord(const ICIMInstance& delta);
TCIMValue PropertyOfRecord(const ICIMInstance& delta);

/// The record that was written last, and its class. Returns false if there is none. Errors: TZELException of the namespace.
bool ReadLastDeltaRecord(TDeltaNamespace& ns, std::string& className, TDeltaRecord& record);

/// Removes one position from the indices of every record. Errors: TZELException of the namespace.
void RemovePosition(TDeltaNamespace& ns, std::size_t position);

/// Removes the positions from the records of one class, named in any letter case. A record that loses its last position is deleted,
/// and so is the record of the class with its last difference. Errors: TZELException of the namespace.
void RemovePositionsOf(TDeltaNamespace& ns, const std::string& className, const std::vector<std::size_t>& positions);

}  // namespace NORVZEL20
