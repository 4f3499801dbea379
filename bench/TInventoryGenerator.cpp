// Generates the inventories of the benchmarks.
//
// Every value is a function of the seed, the number of its instance and its property: a hash of the three is the random number from
// which the value is made. So no state is kept, instances can be written in any order, and equal arguments give equal bytes
// everywhere.
//
// The second state is written by the same functions. Another hash decides which values change (1 %), which instances are left out
// (0.5 %) and after which ones a new instance follows (0.5 %).

#include "bench/TInventoryGenerator.h"

#include <array>
#include <cstdio>

namespace NORVZEL20 {
namespace {

enum EProperty : unsigned int {
    kVersion,
    kVendor,
    kDescription,
    kPath,
    kChecksum,
    kState,
    kSize,
    kFileCount,
    kEnabled,
    kInstallDate,
    kRatio
};

constexpr std::uint64_t kPerMille = 1000;

// A hash whose output bits all depend on all input bits.
std::uint64_t Mix(std::uint64_t value)
{
    value += 0x9e3779b97f4a7c15U;
    value = (value ^ (value >> 30)) * 0xbf58476d1ce4e5b9U;
    value = (value ^ (value >> 27)) * 0x94d049bb133111ebU;
    return value ^ (value >> 31);
}

void AppendProperty(std::string& xml, const char* name, const char* type, const std::string& value)
{
    xml.append("<PROPERTY NAME=\"").append(name).append("\" TYPE=\"").append(type).append("\"><VALUE>");
    xml.append(value).append("</VALUE></PROPERTY>\n");
}

template <class... TArguments>
std::string Format(const char* format, TArguments... arguments)
{
    std::array<char, 128> buffer;
    const int length = std::snprintf(buffer.data(), buffer.size(), format, arguments...);
    return std::string(buffer.data(), static_cast<std::size_t>(length));
}

std::string Description(std::uint64_t random)
{
    static const std::array<const char*, 8> kWords = {"network", "storage", "daemon",   "library",
                                                      "runtime", "support", "security", "console"};
    return Format("%s %s for the %s %s", kWords[random & 7U], kWords[(random >> 3) & 7U], kWords[(random >> 6) & 7U],
                  kWords[(random >> 9) & 7U]);
}

std::string Declaration()
{
    std::string xml = "<CLASS NAME=\"BENCH_Software\">\n";
    const std::string key = "<QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER>";
    for (const char* name : {"CreationClassName", "Name"}) {
        xml.append("<PROPERTY NAME=\"").append(name).append("\" TYPE=\"string\">").append(key).append("</PROPERTY>\n");
    }
    static const std::array<std::array<const char*, 2>, 11> kProperties = {{{"Version", "string"},
                                                                            {"Vendor", "string"},
                                                                            {"Description", "string"},
                                                                            {"Path", "string"},
                                                                            {"Checksum", "string"},
                                                                            {"State", "uint16"},
                                                                            {"Size", "uint64"},
                                                                            {"FileCount", "uint32"},
                                                                            {"Enabled", "boolean"},
                                                                            {"InstallDate", "datetime"},
                                                                            {"Ratio", "real64"}}};
    for (const auto& property : kProperties) {
        xml.append("<PROPERTY NAME=\"").append(property[0]).append("\" TYPE=\"").append(property[1]).append("\"/>\n");
    }
    return xml.append("</CLASS>\n");
}

}  // namespace

std::uint64_t TInventoryGenerator::Random(std::uint64_t number, unsigned int property, bool second) const
{
    const std::uint64_t random = Mix(fSeed ^ Mix(number * 16 + property));
    const bool changed = second && Mix(random) % kPerMille < 10;
    return changed ? Mix(random + 1) : random;
}

void TInventoryGenerator::AppendInstance(std::string& xml, std::uint64_t number, bool second) const
{
    const auto random = [&](EProperty property) { return static_cast<unsigned long long>(Random(number, property, second)); };
    xml.append("<VALUE.OBJECT><INSTANCE CLASSNAME=\"BENCH_Software\">\n");
    AppendProperty(xml, "CreationClassName", "string", "BENCH_Software");
    AppendProperty(xml, "Name", "string", Format("package-%08llu", static_cast<unsigned long long>(number)));
    const auto version = random(kVersion);
    AppendProperty(xml, "Version", "string",
                   Format("%llu.%llu.%llu-%llu", version % 10, version / 16 % 40, version / 1024 % 100, version / 131072 % 1000));
    AppendProperty(xml, "Vendor", "string", Format("Vendor %llu Incorporated", random(kVendor) % 200));
    AppendProperty(xml, "Description", "string", Description(random(kDescription)));
    AppendProperty(xml, "Path", "string",
                   Format("/usr/lib/bench/%08llx/module-%04llu", random(kPath) & 0xffffffffU, random(kPath) >> 32 & 4095U));
    AppendProperty(xml, "Checksum", "string", Format("%016llx%016llx", random(kChecksum), Mix(random(kChecksum))));
    AppendProperty(xml, "State", "uint16", Format("%llu", random(kState) % 12));
    AppendProperty(xml, "Size", "uint64", Format("%llu", random(kSize) % 5000000000U));
    AppendProperty(xml, "FileCount", "uint32", Format("%llu", random(kFileCount) % 20000));
    AppendProperty(xml, "Enabled", "boolean", random(kEnabled) % 2 == 0 ? "TRUE" : "FALSE");
    const auto date = random(kInstallDate);
    AppendProperty(xml, "InstallDate", "datetime",
                   Format("20%02llu%02llu%02llu%02llu%02llu%02llu.000000+060", date % 25, date / 32 % 12 + 1, date / 512 % 28 + 1,
                          date / 16384 % 24, date / 1048576 % 60, date / 67108864 % 60));
    AppendProperty(xml, "Ratio", "real64", Format("%.3f", static_cast<double>(random(kRatio) % 1000000) / 1000.0));
    xml.append("</INSTANCE></VALUE.OBJECT>\n");
}

void TInventoryGenerator::Write(std::ostream& out, bool second) const
{
    out << "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>\n"
        << "<QUALIFIER.DECLARATION NAME=\"Key\" TYPE=\"boolean\" OVERRIDABLE=\"false\"><SCOPE PROPERTY=\"true\" "
           "REFERENCE=\"true\"/>"
        << "<VALUE>FALSE</VALUE></QUALIFIER.DECLARATION>\n<VALUE.OBJECT>" << Declaration() << "</VALUE.OBJECT>\n";
    std::string xml;
    for (std::uint64_t number = 0; number < fInstances; ++number) {
        const std::uint64_t fate = Mix(fSeed + Mix(number)) % kPerMille;
        if (!second || fate >= 5) {
            AppendInstance(xml, number, second);
        }
        if (second && fate >= 5 && fate < 10) {
            AppendInstance(xml, fInstances + number, true);
        }
        out << xml;
        xml.clear();
    }
    out << "</DECLGROUP></DECLARATION></CIM>\n";
}

}  // namespace NORVZEL20
