#pragma once

#include <random>
#include <string>

namespace NORVZEL20 {

/// Returns the document with up to three small changes: bytes added, left out or replaced, or its end cut off. The bytes added are
/// mostly parts of XML that a parser has to look at twice. The same generator gives the same changes on every machine.
std::string MutateXml(std::string document, std::mt19937& random);

}  // namespace NORVZEL20
