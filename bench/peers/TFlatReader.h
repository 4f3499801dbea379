#pragma once

#include <expat.h>

#include <cstddef>
#include <string>
#include <string_view>
#include <unordered_map>

#include "bench/peers/TFlatInventory.h"

namespace NORVZEL20 {

/// Fills a TFlatInventory from the events of Expat. For a single use.
class TFlatReader {
  public:
    TFlatReader(TFlatInventory& inventory, const std::string& path);
    TFlatReader(const TFlatReader&) = delete;
    TFlatReader& operator=(const TFlatReader&) = delete;
    ~TFlatReader();

    /// Throws as the constructor of TFlatInventory.
    void Read();

  private:
    void Start(std::string_view element, const char** attributes);
    void End(std::string_view element);
    void StartInstance(const std::string& className);
    void StartValue(const std::string& property);
    [[noreturn]] void Refuse(const std::string& reason) const;

    TFlatInventory& fInventory;
    std::string fPath;
    XML_Parser fParser;
    std::unordered_map<std::string, std::size_t> fClassNumbers;
    std::string fFault;  // the first fault of a handler, which must not throw through Expat
    bool fIsInInstance = false;
    std::string* fSlot = nullptr;  // of the property that is open
    bool fIsInValue = false;
    std::size_t fNextProperty = 0;  // properties usually come in the order of their declaration
};

}  // namespace NORVZEL20
