#include "tests/embedded/mof/TMofLoading.h"

#include <boost/smart_ptr/make_shared.hpp>
#include <sstream>

#include "embedded/cimxml/TCimXmlWriter.h"
#include "embedded/mof/TMofPopulator.h"
#include "embedded/store/TInMemClass.h"

namespace NORVZEL20 {

bool TMofFiles::Find(const std::string& name, const std::string& from, TFile& file, std::string& reason)
{
    file.name = name;
    file.identity = name;
    reason = "which " + from + " may not include";
    return fTexts.count(name) > 0;
}

bool TMofFiles::Read(const TFile& file, std::size_t most, std::string& bytes, std::string& reason)
{
    bytes = fTexts[file.identity];
    reason = "which is too long";
    return bytes.size() <= most;
}

TMofLoading::TMofLoading() : fNamespace(TInMemNamespace::Create("root/cimv2")) {}

TMofLoading& TMofLoading::File(const std::string& name, const std::string& text)
{
    if (!fFiles) {
        fFiles = boost::make_shared<TMofFiles>();
    }
    fFiles->fTexts[name] = text;
    return *this;
}

TLoadReport TMofLoading::Load(const std::string& document)
{
    return TMofPopulator(fNamespace, fFiles).LoadFromMemory(document.data(), document.size(), "doc.mof");
}

std::string TMofLoading::ErrorOf(const std::string& document)
{
    try {
        Load(document);
        return std::string();
    } catch (const TPopulateError& error) {
        return error.what();
    }
}

int TMofLoading::StatusOf(const std::string& document)
{
    try {
        Load(document);
        return 0;
    } catch (const TZELException& error) {
        return error.GetStatusCode().GetStatus();
    }
}

TCIMValue TMofLoading::RawValueOf(const std::string& path, const std::string& property) const
{
    const boost::shared_ptr<ICIMInstance> instance = fNamespace->GetInstance(TCIMReference::Parse(path), TCallContext());
    return instance->GetProperty(property, TCallContext())->GetValue(TCallContext());
}

std::string TMofLoading::ValueOf(const std::string& path, const std::string& property) const
{
    return RawValueOf(path, property).ToText();
}

std::string TMofLoading::ClassOf(const std::string& name) const
{
    const boost::shared_ptr<TInMemClass> cls = fNamespace->FindClass(name);
    if (!cls) {
        return "no class " + name;
    }
    std::string text;
    TCimXmlWriter writer([&](std::string_view piece) { text += piece; });
    writer.StartDocument();
    writer.WriteClass(*cls);
    writer.EndDocument();
    const std::size_t begin = text.find("<CLASS ");
    return text.substr(begin, text.find("</VALUE.OBJECT>") - begin);
}

std::string TMofLoading::Write() const
{
    std::string text;
    TCimXmlWriter writer([&](std::string_view piece) { text += piece; });
    writer.WriteNamespace(*fNamespace);
    return text;
}

std::string TMofLoading::Instances() const
{
    std::istringstream lines(Write());
    std::string instances;
    for (std::string line; std::getline(lines, line);) {
        const std::size_t begin = line.find("<INSTANCE ");
        const std::size_t end = line.find("</VALUE.OBJECT>");
        if (begin != std::string::npos && begin < end) {
            instances += line.substr(begin, end - begin) + "\n";
        }
    }
    return instances;
}

std::string TMofLoading::Tolerated(const TLoadReport& report)
{
    std::string lines;
    for (const TLoadReport::TTolerated& tolerated : report.tolerated) {
        lines += std::to_string(tolerated.line) + ": " + tolerated.text + " (" + std::to_string(tolerated.count) + ")\n";
    }
    return lines;
}

}  // namespace NORVZEL20
