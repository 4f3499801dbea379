#include "client/wbem/FindNamespaces.h"

#include <boost/algorithm/string/trim.hpp>

#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

const std::size_t kMostNamespaces = 1000;

const char* const kInterop[] = {"root/interop", "interop", "root/PG_InterOp", "root"};

// The names of the instances of a class; nothing if the server cannot say.
std::vector<std::string> NamesOf(TWbemServer& server, const std::string& namespaceName, const char* className)
{
    try {
        return server.Ask(EnumerateInstanceNames(namespaceName, className)).names;
    } catch (const TWbemFault& fault) {
        if (!fault.IsOfThisRequest()) {
            throw;
        }
        return {};
    }
}

// By letter case, a name counts once, as it came first.
void AddNames(TNameMap<bool>& found, const std::vector<std::string>& names, const std::string& above)
{
    for (const std::string& name : names) {
        const std::string plain = boost::algorithm::trim_copy_if(name, [](char c) { return c == '/' || c == ' '; });
        if (!plain.empty() && found.size() < kMostNamespaces) {
            found.emplace(above + plain, false);
        }
    }
}

// Goes down from each namespace that was not asked yet.
void AddBelow(TWbemServer& server, TNameMap<bool>& found)
{
    for (auto next = found.begin(); next != found.end();) {
        if (next->second) {
            ++next;
            continue;
        }
        next->second = true;
        const std::string above = next->first;
        AddNames(found, NamesOf(server, above, "__Namespace"), above + "/");
        next = found.begin();
    }
}

}  // namespace

std::vector<std::string> FindNamespaces(TWbemServer& server)
{
    TNameMap<bool> found;  // whether it was asked for those below it
    for (const char* interop : kInterop) {
        AddNames(found, NamesOf(server, interop, "CIM_Namespace"), "");
        if (!found.empty()) {
            found.emplace(interop, false);
            break;
        }
    }
    if (found.empty()) {
        AddNames(found, NamesOf(server, "root", "__Namespace"), "root/");
        AddBelow(server, found);
    }
    std::vector<std::string> names;
    for (const auto& entry : found) {
        names.push_back(entry.first);
    }
    return names;
}

}  // namespace NORVZEL20
