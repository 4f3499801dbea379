#include "client/collect/CollectKinds.h"
#include "client/collect/read/ReadAccounts.h"

namespace NORVZEL20 {

void CollectUsers(TCollection& collection)
{
    collection.AddFrom("/etc/passwd", &ReadUsers);
    collection.AddFrom("/etc/group", &ReadGroups);
}

}  // namespace NORVZEL20
