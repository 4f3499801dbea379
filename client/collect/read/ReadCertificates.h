#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "client/collect/read/TFacts.h"
#include "client/collect/read/TReadFaults.h"

namespace NORVZEL20 {

/// The X.509 certificates in a file as KALMO_Certificate: one in DER, or any number in PEM, with anything around them. `path`
/// becomes part of their keys. Keys and everything else in the file are passed over.
std::vector<TFacts> ReadCertificates(std::string_view bytes, const std::string& path, TReadFaults& faults);

}  // namespace NORVZEL20
