#include "client/inventory/TSuggestedCommand.h"

#include <sys/stat.h>

#include <algorithm>

#include "client/text/DisplayText.h"
#include "client/text/QuoteForShell.h"

namespace NORVZEL20 {

namespace {

bool CanBeReadAgain(const std::string& path)
{
    struct stat status;
    // A name that begins with a hyphen would be taken for an option.
    return path.compare(0, 1, "-") != 0 && stat(path.c_str(), &status) == 0 && S_ISREG(status.st_mode);
}

}  // namespace

TSuggestedCommand& TSuggestedCommand::Add(const std::string& word)
{
    fText += " " + QuoteForShell(word);
    fCanBeRun = fCanBeRun && EscapeForDisplay(word) == word;
    return *this;
}

TSuggestedCommand& TSuggestedCommand::AddFile(const std::string& path)
{
    fCanBeRun = fCanBeRun && CanBeReadAgain(path);
    return Add(path);
}

TSuggestedCommand& TSuggestedCommand::AddInventory(const TInventory& inventory)
{
    return AddArgument(inventory).AddLoading(inventory.loading, inventory.loading.schemaOption);
}

TSuggestedCommand& TSuggestedCommand::AddSchemas(const std::vector<TInventory>& inventories, bool strictSchema)
{
    for (const TInventory& inventory : inventories) {
        Add("--schema").AddArgument(inventory);
    }
    if (!inventories.empty()) {
        AddLoading(inventories.front().loading, "--declarations");
    }
    return strictSchema ? Add("--strict-schema") : *this;
}

TSuggestedCommand& TSuggestedCommand::AddArgument(const TInventory& inventory)
{
    fCanBeRun = fCanBeRun && std::all_of(inventory.files.begin(), inventory.files.end(), &CanBeReadAgain);
    return Add(inventory.path);
}

TSuggestedCommand& TSuggestedCommand::AddLoading(const TLoadingOptions& options, const std::string& schemaOption)
{
    for (const std::string& name : options.namespaces) {
        Add("--namespace").Add(name);
    }
    if (options.badValues != EBadValues::kRefuse) {
        Add("--bad-values").Add(options.badValues == EBadValues::kNull ? "null" : "text");
    }
    for (const std::string& list : options.schemas) {
        Add(schemaOption).Add(list);
    }
    fCanBeRun = fCanBeRun && std::all_of(options.schemaFiles.begin(), options.schemaFiles.end(), &CanBeReadAgain);
    return options.infersClasses ? Add("--infer-classes") : *this;
}

std::string TSuggestedCommand::Advise(const std::string& purpose) const
{
    return fCanBeRun ? "; " + fText + " " + purpose : "";
}

}  // namespace NORVZEL20
