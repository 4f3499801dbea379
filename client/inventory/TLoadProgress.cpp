#include "client/inventory/TLoadProgress.h"

#include <sys/stat.h>

#include <algorithm>

#include "client/files/TInputFile.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

constexpr std::uint64_t kKilobyte = 1000;
constexpr std::uint64_t kMegabyte = 1000 * kKilobyte;

// The sum of the sizes; 0 if one of them is not known.
std::uint64_t SizeOf(const std::vector<std::string>& files)
{
    std::uint64_t sum = 0;
    for (const std::string& file : files) {
        struct stat status;
        if (file == "-" || stat(file.c_str(), &status) != 0 || !S_ISREG(status.st_mode)) {
            return 0;
        }
        sum += static_cast<std::uint64_t>(status.st_size);
    }
    return sum;
}

// The name of its file; the label if it has several.
std::string NameOf(const TInventory& inventory)
{
    if (inventory.files.size() != 1) {
        return EscapeForDisplay(inventory.label);
    }
    const std::string& path = inventory.files.front();
    return EscapeForDisplay(NameOfInput(path.substr(path.rfind('/') + 1)));
}

// "112 of 180 MB"; "112 MB" if the total is 0.
std::string Amount(std::uint64_t read, std::uint64_t total)
{
    const bool isLarge = std::max(read, total) >= kMegabyte;
    const std::uint64_t unit = isLarge ? kMegabyte : kKilobyte;
    return std::to_string(read / unit) + (total == 0 ? "" : " of " + std::to_string(total / unit)) + (isLarge ? " MB" : " kB");
}

}  // namespace

TLoadProgress::TLoadProgress(const std::vector<TInventory>& inventories)
{
    for (const TInventory& inventory : inventories) {
        TItem& item = fItems.emplace_back();
        item.name = NameOf(inventory);
        item.total = SizeOf(inventory.files);
    }
}

void TLoadProgress::End(std::size_t inventory)
{
    fItems[inventory].state = kLoaded;
    ++fLoaded;
}

std::string TLoadProgress::Describe() const
{
    const auto item =
        std::find_if(fItems.begin(), fItems.end(), [](const TItem& candidate) { return candidate.state == kLoading; });
    if (item == fItems.end()) {
        return std::string();
    }
    const std::uint64_t read = item->read.load(std::memory_order_relaxed);
    const std::string amount = Amount(read, item->total);
    // A file may grow while it is read.
    const std::string text =
        item->name + " " +
        (item->total == 0 ? amount
                          : std::to_string(std::min<std::uint64_t>(read * 100 / item->total, 100)) + " % (" + amount + ")");
    const std::size_t position = std::min(fLoaded + 1, fItems.size());
    return fItems.size() == 1 ? text : text + ", " + std::to_string(position) + " of " + std::to_string(fItems.size());
}

}  // namespace NORVZEL20
