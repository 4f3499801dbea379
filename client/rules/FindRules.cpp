#include "client/rules/FindRules.h"

#include <unistd.h>

#include <algorithm>
#include <cctype>

#include "host/TOSSpecific.h"

namespace NORVZEL20 {

namespace {

bool IsWord(const std::string& name)
{
    return !name.empty() && std::all_of(name.begin(), name.end(), [](unsigned char c) { return std::isalnum(c) != 0 || c == '_'; });
}

std::string ShippedRules(const std::string& name)
{
    return TOSSpecific::GetZELRootPath() + "/data/rules/" + name + ".xml";
}

}  // namespace

std::string FindRules(const std::string& name)
{
    if (!IsWord(name) || access(name.c_str(), F_OK) == 0) {
        return name;
    }
    const std::string shipped = ShippedRules(name);
    return access(shipped.c_str(), R_OK) == 0 ? shipped : name;
}

std::string WhyNoRules(const std::string& name)
{
    return IsWord(name) ? ", and the program has no rules " + ShippedRules(name) : std::string();
}

}  // namespace NORVZEL20
