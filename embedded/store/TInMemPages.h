#pragma once

#include <cstddef>

#include "embedded/store/TInMemPage.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// Where the instances of one class get their memory.
///
/// Instances of a class are read one after the other, but an inventory may list them among those of other classes. In pages of
/// their own they lie side by side all the same.
/// Threads: as the namespace.
class CIMDELTA_INTERNAL_EXPORT TInMemPages {
  public:
    /// A page with room for a block of so many bytes, a multiple of 8. Valid until the next call. Errors: std::bad_alloc.
    TInMemPage& GetPageFor(std::size_t bytes);

  private:
    TInMemPage::TPointer fPage;  // the one that is being filled, or null
    std::size_t fTaken = 0;      // bytes of all blocks so far
};

}  // namespace NORVZEL20
