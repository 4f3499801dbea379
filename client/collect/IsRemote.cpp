#include "client/collect/IsRemote.h"

#include <algorithm>

#include "client/collect/read/TextPieces.h"

namespace NORVZEL20 {

bool IsRemote(const std::string& fileSystemType)
{
    constexpr const char* kTypes[] = {"nfs",      "nfs4",      "cifs",   "smb3", "smbfs", "ncpfs",  "afs",  "ceph",  "9p",
                                      "virtiofs", "glusterfs", "lustre", "gfs2", "ocfs2", "autofs", "coda", "davfs", "beegfs"};
    return StartsWith(fileSystemType, "fuse") ||
           std::find(std::begin(kTypes), std::end(kTypes), fileSystemType) != std::end(kTypes);
}

}  // namespace NORVZEL20
