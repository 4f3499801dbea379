// Generates the inventories of the benchmarks.
//
// Every value is a function of the number of its instance and its property: a hash of the two is the random number from which the
// value is made. So no state is kept, instances can be written in any order, and equal arguments give equal bytes everywhere.
//
// The other states are written by the same functions. Another hash, which depends on the state, decides which values change, which
// instances are left out (0.5 %) and which ones are followed by a new instance (0.5 %). The name of a new instance continues the
// name of the one before it, so an inventory in key order stays in key order.

#include "bench/TInventoryGenerator.h"

#include <array>
#include <cstdio>
#include <numeric>
#include <utility>

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
constexpr std::uint64_t kMissingPerMille = 5;
constexpr std::uint64_t kNewPerMille = 5;
constexpr std::uint64_t kSeed = 1;

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
    const auto word = [&](unsigned int place) { return kWords[(random >> (3 * place)) & 7U]; };
    return Format("%s %s for the &quot;%s %s&quot; %s, with %s &amp; %s", word(0), word(1), word(2), word(3), word(4), word(5),
                  word(6));
}

std::string Declaration(const std::string& name)
{
    std::string xml = "<VALUE.OBJECT><CLASS NAME=\"" + name + "\">\n";
    const std::string key = "<QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER>";
    for (const char* property : {"CreationClassName", "Name"}) {
        xml.append("<PROPERTY NAME=\"").append(property).append("\" TYPE=\"string\">").append(key).append("</PROPERTY>\n");
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
    return xml.append("</CLASS></VALUE.OBJECT>\n");
}

}  // namespace

std::vector<std::uint64_t> TInventoryGenerator::Order() const
{
    std::vector<std::uint64_t> order(fShape.instances);
    std::iota(order.begin(), order.end(), std::uint64_t{0});
    for (std::size_t place = order.size(); fShape.shuffleSeed != 0 && place > 1; --place) {
        std::swap(order[place - 1], order[Mix(Mix(fShape.shuffleSeed) + place) % place]);
    }
    return order;
}

std::string TInventoryGenerator::ClassOf(std::uint64_t number) const
{
    if (fShape.classes == 1) {
        return "BENCH_Software";
    }
    return Format("BENCH_Software%03llu", static_cast<unsigned long long>(number * fShape.classes / fShape.instances));
}

std::uint64_t TInventoryGenerator::Random(std::uint64_t number, unsigned int property, unsigned int state) const
{
    const std::uint64_t random = Mix(kSeed ^ Mix(number * 16 + property));
    const bool changed = state != 0 && Mix(random + state - 1) % kPerMille < fShape.changedPerMille;
    return changed ? Mix(random + state) : random;
}

void TInventoryGenerator::AppendInstance(std::string& xml, std::uint64_t number, unsigned int state, bool isNew) const
{
    const std::uint64_t source = isNew ? number + std::uint64_t{fShape.instances} * state : number;
    const auto random = [&](EProperty property) { return static_cast<unsigned long long>(Random(source, property, state)); };
    const std::string className = ClassOf(number);
    xml.append("<VALUE.OBJECT><INSTANCE CLASSNAME=\"").append(className).append("\">\n");
    AppendProperty(xml, "CreationClassName", "string", className);
    const std::string name = Format("package-%08llu", static_cast<unsigned long long>(number));
    AppendProperty(xml, "Name", "string", isNew ? name + Format(".%u", state) : name);
    const auto version = random(kVersion);
    AppendProperty(xml, "Version", "string",
                   Format("%llu.%llu.%llu-%llu", version % 10, version / 16 % 40, version / 1024 % 100, version / 131072 % 1000));
    AppendProperty(xml, "Vendor", "string", Format("Vendor %llu Incorporated", random(kVendor) % 200));
    AppendProperty(xml, "Description", "string", Description(random(kDescription)));
    AppendProperty(xml, "Path", "string",
                   Format("/usr/lib/bench/%08llx/module-%04llu.so", random(kPath) & 0xffffffffU, random(kPath) >> 32 & 4095U));
    AppendProperty(xml, "Checksum", "string",
                   Format("%016llx%016llx%08llx", random(kChecksum), Mix(random(kChecksum)), random(kChecksum) >> 32));
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

void TInventoryGenerator::Write(std::ostream& out, unsigned int state) const
{
    out << "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>\n"
        << "<QUALIFIER.DECLARATION NAME=\"Key\" TYPE=\"boolean\" OVERRIDABLE=\"false\"><SCOPE PROPERTY=\"true\" "
           "REFERENCE=\"true\"/>"
        << "<VALUE>FALSE</VALUE></QUALIFIER.DECLARATION>\n";
    for (std::uint64_t number = 0; number < fShape.classes; ++number) {
        // The first instance of the class is the first whose share of all instances reaches that of the class.
        out << Declaration(ClassOf((number * fShape.instances + fShape.classes - 1) / fShape.classes));
    }
    std::string xml;
    for (const std::uint64_t number : Order()) {
        const std::uint64_t fate = Mix(kSeed + state - 1 + Mix(number)) % kPerMille;
        if (state == 0 || fate >= kMissingPerMille) {
            AppendInstance(xml, number, state, false);
        }
        if (state != 0 && fate >= kMissingPerMille && fate < kMissingPerMille + kNewPerMille) {
            AppendInstance(xml, number, state, true);
        }
        out << xml;
        xml.clear();
    }
    out << "</DECLGROUP></DECLARATION></CIM>\n";
}

}  // namespace NORVZEL20
