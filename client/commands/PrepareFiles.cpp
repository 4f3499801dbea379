#include "client/commands/PrepareFiles.h"

#include <utility>

#include "client/baseline/ReadBaseline.h"
#include "client/commands/SaveRules.h"
#include "client/inventory/CheckInventoryFiles.h"
#include "client/inventory/DropRepeatedFiles.h"
#include "client/inventory/LoadSchema.h"
#include "client/inventory/ReadInventoryArgument.h"
#include "client/process/TClientError.h"
#include "client/report/TResultOutput.h"

namespace NORVZEL20 {

namespace {

// One result must not replace another.
void CheckOutputsDiffer(const TCommandFiles& files)
{
    const std::pair<const char*, const std::string*> outputs[] = {
        {"--output", &files.output}, {"--accept", &files.accept}, {"--save-rules", &files.savedRules}};
    for (const auto& [option, path] : outputs) {
        for (const auto* other = outputs; other->second != path; ++other) {
            const bool areWritten = !path->empty() && (!other->second->empty() || other->second == &files.output);
            if (areWritten && AreSameTarget(*path, *other->second)) {
                throw TClientError(*path + ": found for both " + option + " and " + other->first +
                                   ", expected two files; name another one");
            }
        }
    }
}

// Checks the files of accepted differences and adds them to the inputs.
void CheckBaselineFiles(const TCommandFiles& files, std::vector<std::string>& inputs)
{
    for (const std::string* const path : {&files.baseline, &files.accept}) {
        if (*path == "-") {
            throw TClientError("found - for accepted differences, expected a file; name one");
        }
    }
    if (!files.baseline.empty()) {
        CheckBaseline(files.baseline);
        inputs.push_back(files.baseline);
    }
    if (files.accept.empty()) {
        return;
    }
    CheckPlainOutput(files.accept, inputs);
    inputs.push_back(files.accept);
}

}  // namespace

std::vector<TInventorySources> PrepareFiles(const TCommandFiles& files, TLoadingOptions& loading, std::size_t fewest,
                                            IConsole& console)
{
    std::vector<TInventorySources> inventories;
    std::vector<std::string> inputs;
    for (const std::string& argument : files.inventories) {
        inventories.push_back(ReadInventoryArgument(argument, console));
        inputs.insert(inputs.end(), inventories.back().files.begin(), inventories.back().files.end());
    }
    loading.schemaFiles = ListSchemaFiles(loading, console);
    inputs.insert(inputs.end(), loading.schemaFiles.begin(), loading.schemaFiles.end());
    const std::vector<std::string> toLoad = inputs;
    if (!files.rules.empty()) {
        inputs.push_back(files.rules);
    }
    CheckOutputsDiffer(files);
    CheckBaselineFiles(files, inputs);
    CheckOutput(files.output, inputs);
    CheckSavedRules(files.savedRules, inputs);
    loading.output = IsStandardOutput(files.output) ? std::string() : files.output;
    CheckInventoryFiles(toLoad);
    inventories = DropRepeatedInventories(std::move(inventories), fewest, console);
    RequireReadableOnce(inventories, loading.schemaFiles, files.rules);
    return inventories;
}

}  // namespace NORVZEL20
