#include "client/AddReportOptions.h"

namespace NORVZEL20 {

void AddReportOptions(CLI::App* command, TTextOptions& text)
{
    CLI::Option* const detail =
        command->add_flag("--detail", text.isDetailed, "show each difference on its own, and all of the coverage");
    // The text is what help shows in place of the options that each excludes.
    detail->option_text(" ");
    command->add_flag("--summary", text.isSummary, "show who differs and how much in each class, without the findings")
        ->excludes(detail)
        ->option_text(" ");
    command->add_flag("--coverage", text.hasWholeCoverage, "show all of what was compared and what not");
    command->add_flag("--full", text.hasWholeKeys, "show keys and values whole, however long they are");
    command
        ->add_option("--limit", text.mostLines,
                     "shorten groups until the findings of a text report take no more lines, if they can (default: 200 on a "
                     "terminal, otherwise none)")
        ->check(CLI::PositiveNumber)
        ->option_text("LINES");
}

}  // namespace NORVZEL20
