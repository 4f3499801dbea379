#pragma once

#include <string>

#include "client/files/IByteSource.h"

namespace NORVZEL20 {

/// The bytes of another source; the first ones can be looked at before they are read.
class TPeekedSource : public IByteSource {
  public:
    /// Reads the first `count` bytes of `source`, or all of them if there are fewer. `source` must outlive this. Errors: those of
    /// its Read.
    TPeekedSource(IByteSource& source, std::size_t count);

    const std::string& GetBeginning() const noexcept { return fBeginning; }

    std::size_t Read(char* buffer, std::size_t size) override;

  private:
    IByteSource& fSource;
    std::string fBeginning;
    std::size_t fDelivered = 0;  // how many of its bytes Read has returned
};

}  // namespace NORVZEL20
