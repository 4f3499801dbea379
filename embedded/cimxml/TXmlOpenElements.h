#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace NORVZEL20 {

/// The names of the elements that are open, outermost first.
class TXmlOpenElements {
  public:
    void Clear() noexcept
    {
        fOpen.clear();
        fCopies.clear();
    }
    bool IsEmpty() const noexcept { return fOpen.empty(); }
    std::size_t GetDepth() const noexcept { return fOpen.size(); }

    /// `name` must end with a NUL that its length does not count. If `isLasting`, the name must live until the element ends;
    /// otherwise it is copied. Errors: std::bad_alloc.
    void Push(const char* name, std::size_t length, bool isLasting)
    {
        fOpen.push_back(
            {isLasting ? name : nullptr, static_cast<std::uint32_t>(fCopies.size()), static_cast<std::uint32_t>(length)});
        if (!isLasting) {
            fCopies.append(name, length + 1);
        }
    }
    /// Ends the innermost element.
    void Pop()
    {
        if (fOpen.back().name == nullptr) {
            fCopies.resize(fOpen.back().copied);
        }
        fOpen.pop_back();
    }

    /// The name of the innermost element, with a NUL behind it. Valid until Push or Pop.
    std::string_view GetName() const noexcept { return GetName(fOpen.back()); }
    /// Start tags of all open elements.
    std::string MakeTags() const
    {
        std::string tags;
        for (const TOpen& open : fOpen) {
            tags.append("<").append(GetName(open)).append(">");
        }
        return tags;
    }

  private:
    struct TOpen {
        const char* name;      // null if it is in fCopies
        std::uint32_t copied;  // how long fCopies was before
        std::uint32_t length;
    };

    std::string_view GetName(const TOpen& open) const noexcept
    {
        return std::string_view(open.name != nullptr ? open.name : fCopies.data() + open.copied, open.length);
    }

    std::vector<TOpen> fOpen;
    std::string fCopies;
};

}  // namespace NORVZEL20
