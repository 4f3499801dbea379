#include "client/inventory/MakeLoadOptions.h"

#include <algorithm>
#include <map>

#include "client/process/TClientError.h"
#include "client/text/SomeOf.h"

namespace NORVZEL20 {

namespace {

// The namespaces by label; that of inventories without one of their own has an empty label.
std::map<std::string, std::string> ReadNamespaces(const TLoadingOptions& options, const std::vector<std::string>& labels)
{
    std::map<std::string, std::string> names;
    for (const std::string& text : options.namespaces) {
        const std::size_t end = text.rfind('=');  // a label may have one in it, the name of a namespace may not
        const std::string label = end == std::string::npos ? std::string() : text.substr(0, end);
        if (end != std::string::npos && std::find(labels.begin(), labels.end(), label) == labels.end()) {
            throw TClientError("--namespace " + text + ": no inventory has the label " + label +
                               "; name one of these: " + SomeOf(labels));
        }
        const auto [known, isNew] = names.emplace(label, text.substr(end == std::string::npos ? 0 : end + 1));
        if (!isNew) {
            throw TClientError("--namespace " + text + ": another one, " + known->second + ", is named for the same " +
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
