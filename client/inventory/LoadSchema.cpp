#include "client/inventory/LoadSchema.h"

#include "client/inventory/DropRepeatedFiles.h"
#include "client/inventory/LoadFiles.h"
#include "client/inventory/ReadInventoryArgument.h"
#include "client/process/TProgress.h"

namespace NORVZEL20 {

std::vector<std::string> ListSchemaFiles(const TLoadingOptions& options, IConsole& console)
{
    std::vector<std::string> files;
    for (const std::string& list : options.schemas) {
        const std::vector<std::string> more = ReadSourceList(list, console);
        files.insert(files.end(), more.begin(), more.end());
    }
    return DropRepeatedFiles(files, console);
}

boost::shared_ptr<const TInMemNamespace> LoadSchema(const TLoadingOptions& options, IConsole& console)
{
    if (options.schemaFiles.empty()) {
        return nullptr;
    }
    const TProgress progress(console, "loading the schema");
    TLoadOptions load;
    load.takesDeclarationsOnly = true;
    load.badValues = options.badValues;
    const boost::shared_ptr<TInMemNamespace> schema = TInMemNamespace::Create("schema");
    const TLoadReport report = LoadFiles({"the schema", options.schemaFiles, schema}, load, options);
    SayTolerated(report, console);
    SayBadValues(report, console);
    return schema;
}

}  // namespace NORVZEL20
