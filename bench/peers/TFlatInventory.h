#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace NORVZEL20 {

struct TFlatClass {
    std::string name;
    std::vector<std::string> properties;
    std::vector<std::size_t> keys;  ///< positions in `properties`
};

struct TFlatRow {
    std::size_t classNumber = 0;
    std::vector<std::string> values;  ///< one for each property of the class; empty if the document has none
};

/// An inventory as tables of text, one for each class: what a program would make of it that needs nothing but a comparison.
///
/// It understands what the generator writes: classes in front of their instances, no superclasses, no arrays. A null and an
/// empty text are the same to it.
class TFlatInventory {
  public:
    /// Reads the file with Expat, in pieces. Throws std::runtime_error if it cannot be read, is not well-formed, or has an instance
    /// whose class or property is not declared in front of it.
    explicit TFlatInventory(const std::string& path);

    const std::vector<TFlatClass>& Classes() const { return fClasses; }
    const std::vector<TFlatRow>& Rows() const { return fRows; }

    /// Class and key values of a row as one text; rows of equal key texts are the same instance.
    std::string KeyText(const TFlatRow& row) const;

  private:
    friend class TFlatReader;

    std::vector<TFlatClass> fClasses;
    std::vector<TFlatRow> fRows;
};

}  // namespace NORVZEL20
