#pragma once

#include <cstdint>
#include <string>

namespace NORVZEL20 {

/// Makes the header of a package as the rpm database stores it.
class TRpmHeaderBuilder {
  public:
    TRpmHeaderBuilder& Text(std::uint32_t tag, const std::string& text)
    {
        Tag(tag, 6, static_cast<std::uint32_t>(fData.size()));
        fData += text + '\0';
        return *this;
    }

    TRpmHeaderBuilder& Number(std::uint32_t tag, std::uint32_t number)
    {
        Tag(tag, 4, static_cast<std::uint32_t>(fData.size()));
        fData += Bytes(number);
        return *this;
    }

    /// A tag whose value stands at `offset`.
    TRpmHeaderBuilder& Tag(std::uint32_t tag, std::uint32_t type, std::uint32_t offset)
    {
        fTags += Bytes(tag) + Bytes(type) + Bytes(offset) + Bytes(1);
        return *this;
    }

    std::string GetBytes() const
    {
        return Bytes(static_cast<std::uint32_t>(fTags.size() / 16)) + Bytes(static_cast<std::uint32_t>(fData.size())) + fTags +
               fData;
    }

  private:
    static std::string Bytes(std::uint32_t number)
    {
        std::string bytes;
        for (const unsigned int shift : {24U, 16U, 8U, 0U}) {
            bytes += static_cast<char>(number >> shift & 0xFFU);
        }
        return bytes;
    }

    std::string fTags;
    std::string fData;
};

}  // namespace NORVZEL20
