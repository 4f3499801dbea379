// From the name of an element to its number.
//
// This happens for every tag, so the names are in a hash table that the compiler builds. The hash takes the length and three
// characters: the names differ in these almost always, and one comparison of the whole name settles the rest.
#include "embedded/cimxml/TCimXmlElement.h"

#include <array>
#include <cstddef>
#include <cstring>
#include <string_view>

namespace NORVZEL20 {

namespace {

using E = TCimXmlElement;

// In the order of EElement.
constexpr std::array<std::string_view, E::kCount> kNames = {"",
                                                            "CIM",
                                                            "CLASS",
                                                            "CLASSNAME",
                                                            "CLASSPATH",
                                                            "CORRELATOR",
                                                            "DECLARATION",
                                                            "DECLGROUP",
                                                            "DECLGROUP.WITHNAME",
                                                            "DECLGROUP.WITHPATH",
                                                            "ERROR",
                                                            "HOST",
                                                            "IMETHODCALL",
                                                            "IMETHODRESPONSE",
                                                            "INSTANCE",
                                                            "INSTANCENAME",
                                                            "INSTANCEPATH",
                                                            "IPARAMVALUE",
                                                            "IRETURNVALUE",
                                                            "KEYBINDING",
                                                            "KEYVALUE",
                                                            "LOCALCLASSPATH",
                                                            "LOCALINSTANCEPATH",
                                                            "LOCALNAMESPACEPATH",
                                                            "MESSAGE",
                                                            "METHOD",
                                                            "METHODCALL",
                                                            "METHODRESPONSE",
                                                            "MULTIREQ",
                                                            "MULTIRSP",
                                                            "NAMESPACE",
                                                            "NAMESPACEPATH",
                                                            "OBJECTPATH",
                                                            "PARAMETER",
                                                            "PARAMETER.ARRAY",
                                                            "PARAMETER.REFARRAY",
                                                            "PARAMETER.REFERENCE",
                                                            "PARAMVALUE",
                                                            "PROPERTY",
                                                            "PROPERTY.ARRAY",
                                                            "PROPERTY.REFARRAY",
                                                            "PROPERTY.REFERENCE",
                                                            "QUALIFIER",
                                                            "QUALIFIER.DECLARATION",
                                                            "RETURNVALUE",
                                                            "SCOPE",
                                                            "SIMPLEREQ",
                                                            "SIMPLERSP",
                                                            "VALUE",
                                                            "VALUE.ARRAY",
                                                            "VALUE.INSTANCEWITHPATH",
                                                            "VALUE.NAMEDINSTANCE",
                                                            "VALUE.NAMEDOBJECT",
                                                            "VALUE.NULL",
                                                            "VALUE.OBJECT",
                                                            "VALUE.OBJECTWITHLOCALPATH",
                                                            "VALUE.OBJECTWITHPATH",
                                                            "VALUE.REFARRAY",
                                                            "VALUE.REFERENCE"};

constexpr std::size_t kBuckets = 256;

constexpr std::size_t GetBucket(std::string_view name)
{
    if (name.empty()) {
        return 0;
    }
    const auto at = [&](std::size_t index) { return static_cast<unsigned char>(name[index]); };
    return (name.size() * 37 + at(0) * 7 + at(name.size() - 1) * 11 + at(name.size() / 2) * 3) % kBuckets;
}

/// A hash table with open addressing, computed by the compiler.
constexpr std::array<unsigned char, kBuckets> MakeBuckets()
{
    std::array<unsigned char, kBuckets> buckets{};
    for (unsigned char element = 1; element < E::kCount; ++element) {
        // The table has more places than there are elements, so a free one is always found.
        std::size_t bucket = GetBucket(kNames[element]);
        while (buckets[bucket] != E::kUnknown) {
            bucket = (bucket + 1) % kBuckets;
        }
        buckets[bucket] = element;
    }
    return buckets;
}

constexpr std::array<unsigned char, kBuckets> kElements = MakeBuckets();

}  // namespace

TCimXmlElement::EElement TCimXmlElement::Find(const char* name) noexcept
{
    const std::string_view text(name, std::strlen(name));
    for (std::size_t bucket = GetBucket(text); kElements[bucket] != kUnknown; bucket = (bucket + 1) % kBuckets) {
        if (kNames[kElements[bucket]] == text) {
            return static_cast<EElement>(kElements[bucket]);
        }
    }
    return kUnknown;
}

const char* TCimXmlElement::GetName(EElement element) noexcept
{
    return kNames[element].data();
}

}  // namespace NORVZEL20
