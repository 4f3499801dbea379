#include "client/AddBaseline.h"

#include "client/AddText.h"

namespace NORVZEL20 {

void AddBaseline(CLI::App* command, TBaselineOptions& options)
{
    CLI::Option* const accept =
        AddText(command, "--accept", options.accept,
                "keep the present differences in this file, as accepted ones; what it has and is still there stays as it is");
    accept->option_text("FILE");
    AddText(command, "--baseline", options.baseline,
            "report what is new, gone or changed since --accept wrote this file; status 0 if nothing is new or changed")
        ->option_text("FILE")
        ->excludes(accept);
    AddText(command, "--reason", options.reason, "why --accept accepts what is new; stands in the file beside it")
        ->option_text("TEXT")
        ->needs(accept);
}

}  // namespace NORVZEL20
