// A header of the rpm database: what is known of a package, as a list of tags. All numbers have 32 bits, the highest byte first.
//
//   number of tags | length of the data | tags, 16 bytes each: tag, type, offset of its value in the data, number of values | data
//
// A text is in the data with a zero byte behind it. Every number is checked: a database may be damaged.
#include "client/collect/read/ReadRpmHeader.h"

#include <cstddef>
#include <cstdint>
#include <optional>

namespace NORVZEL20 {

namespace {

constexpr std::size_t kRpmIntroLength = 8;
constexpr std::size_t kRpmTagLength = 16;

enum ERpmTag : std::uint32_t {
    kRpmName = 1000,
    kRpmVersion = 1001,
    kRpmRelease = 1002,
    kRpmEpoch = 1003,
    kRpmVendor = 1011,
    kRpmArchitecture = 1022,
    kRpmSource = 1044,
};

enum ERpmType : std::uint32_t { kRpmNumber = 4, kRpmText = 6, kRpmTexts = 8, kRpmTranslatedText = 9 };

class TRpmHeader {
  public:
    explicit TRpmHeader(std::string_view bytes) : fBytes(bytes) {}

    // Whether tags and data are as long as the beginning says.
    bool IsWhole()
    {
        if (fBytes.size() < kRpmIntroLength) {
            return false;
        }
        fTags = Number(0);
        const std::uint64_t length = kRpmIntroLength + std::uint64_t{fTags} * kRpmTagLength + Number(4);
        if (length > fBytes.size()) {
            return false;
        }
        fData = fBytes.substr(kRpmIntroLength + fTags * kRpmTagLength, Number(4));
        return true;
    }

    // Nothing if there is no such tag, or if its value is not within the data.
    std::optional<std::string> Text(ERpmTag tag) const
    {
        const std::optional<TValue> value = Find(tag);
        if (!value || (value->type != kRpmText && value->type != kRpmTexts && value->type != kRpmTranslatedText)) {
            return std::nullopt;
        }
        const std::size_t end = fData.find('\0', value->offset);
        if (value->offset >= fData.size() || end == std::string_view::npos) {
            return std::nullopt;
        }
        return std::string(fData.substr(value->offset, end - value->offset));
    }

    std::optional<std::uint32_t> Epoch() const
    {
        const std::optional<TValue> value = Find(kRpmEpoch);
        if (!value || value->type != kRpmNumber || fData.size() < 4 || value->offset > fData.size() - 4) {
            return std::nullopt;
        }
        return NumberAt(fData, value->offset);
    }

  private:
    struct TValue {
        std::uint32_t type;
        std::size_t offset;
    };

    static std::uint32_t NumberAt(std::string_view bytes, std::size_t place)
    {
        std::uint32_t number = 0;
        for (std::size_t i = 0; i < 4; ++i) {
            number = number << 8U | static_cast<unsigned char>(bytes[place + i]);
        }
        return number;
    }

    std::uint32_t Number(std::size_t place) const { return NumberAt(fBytes, place); }

    std::optional<TValue> Find(ERpmTag tag) const
    {
        for (std::size_t i = 0; i < fTags; ++i) {
            const std::size_t place = kRpmIntroLength + i * kRpmTagLength;
            if (Number(place) == tag) {
                return TValue{Number(place + 4), Number(place + 8)};
            }
        }
        return std::nullopt;
    }

    std::string_view fBytes;
    std::string_view fData;
    std::uint32_t fTags = 0;
};

}  // namespace

bool ReadRpmHeader(std::string_view bytes, TRpmPackage& package, std::string& trouble)
{
    TRpmHeader header(bytes);
    if (!header.IsWhole()) {
        trouble = "found " + std::to_string(bytes.size()) + " bytes, expected a package's header";
        return false;
    }
    const std::optional<std::string> name = header.Text(kRpmName);
    const std::optional<std::string> version = header.Text(kRpmVersion);
    const std::optional<std::string> release = header.Text(kRpmRelease);
    if (!name || name->empty() || !version || !release) {
        trouble = "found a header without name, version or release, expected all three";
        return false;
    }
    const std::optional<std::uint32_t> epoch = header.Epoch();
    package.name = *name;
    package.version = (epoch ? std::to_string(*epoch) + ":" : "") + *version + "-" + *release;
    package.architecture = header.Text(kRpmArchitecture).value_or("(none)");
    package.source = header.Text(kRpmSource).value_or(std::string());
    package.vendor = header.Text(kRpmVendor).value_or(std::string());
    return true;
}

std::string SourcePackageOf(std::string_view file)
{
    // NAME-VERSION-RELEASE.src.rpm: neither version nor release has a hyphen.
    const std::size_t release = file.rfind('-');
    const std::size_t version = release == std::string_view::npos || release == 0 ? release : file.rfind('-', release - 1);
    return version == std::string_view::npos ? std::string() : std::string(file.substr(0, version));
}

}  // namespace NORVZEL20
