#include "client/AddReportOptions.h"

namespace NORVZEL20 {

namespace {

// What is wrong with a number of lines; empty if nothing is.
std::string RefuseAllButCounts(const std::string& text)
{
    constexpr std::size_t kMostDigits = 18;  // of a number that surely fits
    const bool isCount = !text.empty() && text.size() <= kMostDigits && text.find_first_not_of("0123456789") == std::string::npos &&
                         text.find_first_not_of('0') != std::string::npos;
    return isCount ? std::string() : text + " is no number of lines; give a whole number from 1 on";
}

}  // namespace

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
        ->check(&RefuseAllButCounts)
        ->option_text("LINES");
}

}  // namespace NORVZEL20
