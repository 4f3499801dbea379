#include "client/inventory/MakeLoadOptions.h"

#include <algorithm>
#include <map>

#include "client/process/TClientError.h"
#include "client/text/DisplayText.h"
#include "client/text/SomeOf.h"

namespace NORVZEL20 {

namespace {

[[noreturn]] void RefuseNamespace(const std::string& text, const std::string& reason)
{
    throw TClientError("--namespace " + EscapeForDisplay(text) + ": " + reason);
}

// What stands behind the label. Slashes around a name do not count, but they are no name.
std::string ReadName(const std::string& text, const std::string& name)
{
    if (name.find_first_not_of('/') == std::string::npos) {
        RefuseNamespace(text, "found no name, expected [LABEL=]NAME, such as root/cimv2");
    }
    const auto isWrong = [](unsigned char c) { return c <= ' ' || c == 0x7f || c == ':' || c == '"'; };
    if (std::any_of(name.begin(), name.end(), isWrong)) {
        RefuseNamespace(text, "found " + QuoteForDisplay(name) +
                                  ", expected the name of a namespace, such as root/cimv2, without blanks, colons and quotes");
    }
    return name;
}

// The namespaces by label; that of inventories without one of their own has an empty label.
std::map<std::string, std::string> ReadNamespaces(const TLoadingOptions& options, const std::vector<std::string>& labels)
{
    std::map<std::string, std::string> names;
    for (const std::string& text : options.namespaces) {
        const std::size_t end = text.rfind('=');  // a label may have one in it, the name of a namespace may not
        const std::string label = end == std::string::npos ? std::string() : text.substr(0, end);
        if (end == 0) {
            RefuseNamespace(text, "found an empty label, expected [LABEL=]NAME");
        }
        if (end != std::string::npos && std::find(labels.begin(), labels.end(), label) == labels.end()) {
            RefuseNamespace(text, "no inventory has the label " + label + "; name one of these: " + SomeOf(labels));
        }
        const auto [known, isNew] = names.emplace(label, ReadName(text, text.substr(end == std::string::npos ? 0 : end + 1)));
        if (!isNew) {
            RefuseNamespace(text,
                            "another one, " + known->second + ", is named for the same " +
                                (label.empty() ? "inventories; name it once, or put LABEL= in front of each" : "label; name one"));
        }
    }
    return names;
}

}  // namespace

std::vector<TLoadOptions> MakeLoadOptions(const TLoadingOptions& options, const std::vector<std::string>& labels)
{
    const std::map<std::string, std::string> names = ReadNamespaces(options, labels);
    std::vector<TLoadOptions> loads;
    for (const std::string& label : labels) {
        TLoadOptions load;
        load.badValues = options.badValues;
        const auto own = names.find(label);
        const auto common = names.find("");
        load.namespaceName = own != names.end() ? own->second : common != names.end() ? common->second : "";
        load.infersClasses = options.infersClasses;
        loads.push_back(load);
    }
    return loads;
}

}  // namespace NORVZEL20
