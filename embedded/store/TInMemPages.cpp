#include "embedded/store/TInMemPages.h"

#include <algorithm>

namespace NORVZEL20 {

TInMemPage& TInMemPages::GetPageFor(std::size_t bytes)
{
    if (!fPage || !fPage->HasRoomFor(bytes)) {
        // Pages grow with the class. Most classes have few instances, which must not cost a whole page.
        const std::size_t blocks = std::min(fTaken / 2, TInMemPage::kMostBytes) / bytes;
        fPage = TInMemPage::Create(std::max<std::size_t>(blocks, 1) * bytes);
    }
    fTaken += bytes;
    return *fPage;
}

}  // namespace NORVZEL20
