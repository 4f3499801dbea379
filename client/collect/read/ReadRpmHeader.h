#pragma once

#include <string>
#include <string_view>

#include "client/collect/read/TRpmPackage.h"

namespace NORVZEL20 {

/// Reads a package's header as the rpm database stores it. Returns false, with the reason in `trouble`, if it is none.
bool ReadRpmHeader(std::string_view bytes, TRpmPackage& package, std::string& trouble);

/// The name of the package whose file has that name: bash for bash-5.1.8-9.el9.src.rpm.
std::string SourcePackageOf(std::string_view file);

}  // namespace NORVZEL20
