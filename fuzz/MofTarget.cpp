// Loads a MOF document into a namespace that already holds the sample. What stands behind a line "%%" is the file "x.mof", which
// the document may include.
//
// A refused document must leave the namespace as it was. An accepted one is written as CIM-XML, loaded alone into an empty
// namespace and written again: both texts must be equal, so both forms mean the same.

#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/mof/TMofPopulator.h"
#include "fuzz/Promise.h"
#include "fuzz/SampleInventory.h"
#include "fuzz/TFuzzTarget.h"

namespace NORVZEL20 {

namespace {

/// The one file that a document may include, in any letter case, so that it has several identities.
class TOneFile : public IMofIncludes {
  public:
    explicit TOneFile(std::string_view text) : fText(text) {}

    bool Find(const std::string& name, const std::string&, TFile& file, std::string& reason) override
    {
        file = {name, name};
        reason = "which is not there";
        return TNameText::Equal(name, "x.mof");
    }
    bool Read(const TFile&, std::size_t most, std::string& bytes, std::string& reason) override
    {
        bytes = fText;
        reason = "which is too long";
        return bytes.size() <= most;
    }

  private:
    std::string fText;
};

/// The namespace as a document after the load, or "" if the load was refused.
std::string LoadMof(const boost::shared_ptr<TInMemNamespace>& ns, std::string_view input)
{
    static const std::string fgBefore = WriteDocument(*LoadSample());
    const std::size_t cut = input.find("\n%%\n");
    const auto file = boost::make_shared<TOneFile>(cut == std::string_view::npos ? std::string_view() : input.substr(cut + 4));
    const std::string_view document = input.substr(0, cut);
    try {
        TMofPopulator(ns, file).LoadFromMemory(document.data(), document.size(), "fuzz.mof");
    } catch (const TPopulateError& error) {
        const std::string name = error.GetFile();
        Promise(name == "fuzz.mof" || TNameText::Equal(name, "x.mof"), "an error names the document", error.what());
        Promise(error.GetLine() > 0 && error.GetColumn() > 0, "an error has a place", error.what());
        Promise(!error.GetMessage().empty(), "an error has a text");
        PromiseEqual(fgBefore, WriteDocument(*ns), "a failed load leaves the namespace as it was");
        return std::string();
    }
    return WriteDocument(*ns);
}

/// Whether something could not be written in XML, so that different texts may have become the same.
bool HasReplacements(const std::string& document)
{
    return document.find("\xEF\xBF\xBD") != std::string::npos;
}

}  // namespace

void FuzzMof(std::string_view input)
{
    const std::string loaded = LoadMof(LoadSample(), input);
    if (loaded.empty() || HasReplacements(loaded)) {
        return;
    }
    const boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
    try {
        TCimXmlPopulator(ns).LoadFromMemory(loaded.data(), loaded.size(), "fuzz.xml");
    } catch (const TPopulateError& error) {
        Promise(false, "what was loaded from MOF loads from CIM-XML", error.what());
    }
    PromiseEqual(loaded, WriteDocument(*ns), "what was loaded from MOF is the same from CIM-XML");
}

}  // namespace NORVZEL20
