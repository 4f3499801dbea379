#pragma once

#include <string>

#include "tests/client/TPairFixture.h"

namespace NORVZEL20 {

/// Inventories with disks that mounts refer to.
class TMountFixture : public TPairFixture {
  protected:
    static std::string Reference(const std::string& name, const std::string& path)
    {
        return "<PROPERTY.REFERENCE NAME=\"" + name + "\"><VALUE.REFERENCE>" + path + "</VALUE.REFERENCE></PROPERTY.REFERENCE>";
    }

    /// The path of a disk in a namespace other than that of the inventory.
    static std::string ElsewherePath(const std::string& disk)
    {
        return "<LOCALINSTANCEPATH><LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"elsewhere\"/>"
               "</LOCALNAMESPACEPATH>" +
               Path("Disk", "Name", disk) + "</LOCALINSTANCEPATH>";
    }

    /// An inventory with a mount at "/" of what `path` refers to, or of nothing if that is empty, and further elements.
    static std::string MountOf(const std::string& path, const std::string& more = std::string())
    {
        const std::string declared = Class("Disk", "", KeyProperty("Name")) +
                                     Class("Mount", "", KeyProperty("Point") + "<PROPERTY.REFERENCE NAME=\"Dev\"/>") +
                                     Class("NetworkMount", "Mount", "<PROPERTY.REFERENCE NAME=\"Server\"/>");
        return Document(System() + declared +
                            Instance("Mount", Value("Point", "/") + (path.empty() ? std::string() : Reference("Dev", path))) + more,
                        "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"cimv2\"/></LOCALNAMESPACEPATH>");
    }

    /// The same with a mount of a disk in the inventory.
    static std::string Mounts(const std::string& disk) { return MountOf(Path("Disk", "Name", disk)); }
};

}  // namespace NORVZEL20
