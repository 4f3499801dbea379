#include "client/WrongUsage.h"

#include <boost/algorithm/string/join.hpp>
#include <vector>

namespace NORVZEL20 {

namespace {

std::string DescribeExtras(const std::vector<std::string>& extras)
{
    return boost::algorithm::join(extras, ", ") +
           (extras.size() == 1 ? " is one argument too many" : " are " + std::to_string(extras.size()) + " arguments too many");
}

// The option that the message begins with; null if it begins with anything else.
const CLI::Option* FindNamedOption(const CLI::App& command, const std::string& message)
{
    for (const CLI::Option* option : command.get_options()) {
        if (message.compare(0, option->get_name().size() + 2, option->get_name() + ": ") == 0) {
            return option;
        }
    }
    return nullptr;
}

}  // namespace

std::string DescribeWrongUsage(const CLI::ParseError& error, const CLI::App& app, const CLI::App& command)
{
    if (dynamic_cast<const CLI::ExtrasError*>(&error) != nullptr) {
        return DescribeExtras(app.remaining(true));
    }
    const CLI::Option* const option = FindNamedOption(command, error.what());
    if (option == nullptr || dynamic_cast<const CLI::ArgumentMismatch*>(&error) == nullptr) {
        return error.what();
    }
    const std::string names = option->get_name(false, true);
    return names + (option->count() > 1 ? " can be given only once" : " needs a value");
}

}  // namespace NORVZEL20
