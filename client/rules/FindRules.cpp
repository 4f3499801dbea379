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

}  // namespace

std::string FindRules(const std::string& name)
{
    if (!IsWord(name) || access(name.c_str(), F_OK) == 0) {
        return name;
    }
    const std::string shipped = TOSSpecific::GetZELRootPath() + "/data/rules/" + name + ".xml";
    return access(shipped.c_str(), R_OK) == 0 ? shipped : name;
}

}  // namespace NORVZEL20
