#include "client/inventory/SayNamespaceDoubts.h"

#include <algorithm>

#include "client/text/DisplayText.h"
#include "client/text/SomeOf.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/Trim.h"

namespace NORVZEL20 {

void SayNamespaceDoubts(const TInventory& inventory, const std::string& given, IConsole& console)
{
    const TLoadReport& loaded = inventory.loaded;
    const std::string begin = "cimdelta: " + inventory.path + ": ";
    const std::string taken = EscapeForDisplay(loaded.namespaceName);
    const auto isTaken = [&](const std::string& name) { return TNameText::Equal(name, loaded.namespaceName); };
    const bool isIgnored = !given.empty() && !isTaken(std::string(Trim(given, "/")));
    const std::vector<std::string>& named = loaded.namespacesOfReferences;
    if (isIgnored) {
        console.Say(
            begin +
            (loaded.namespaceOrigin == TLoadReport::kFromDocuments ? "is in namespace " : "all references are to namespace ") +
            taken + ", so --namespace " + given + " is not used for it");
    } else if (!named.empty() && (given.empty() ? loaded.namespaceOrigin == TLoadReport::kFromDefault
                                                : std::none_of(named.begin(), named.end(), isTaken))) {
        console.Say(begin + "names no namespace, and its references are to " + EscapeForDisplay(SomeOf(named)) + "; taken as " +
                    taken + (given.empty() ? "; say which with --namespace [LABEL=]NAME" : ", as --namespace says"));
    }
}

}  // namespace NORVZEL20
