#pragma once

#include <cstddef>
#include <string>

namespace NORVZEL20 {

/// Something about an inventory's schema that a person should know: what the client did to it before the comparison, so that it
/// could take place, or what it could not do.
struct TSchemaNote {
    enum EKind {
        kClassDeclared,        ///< a class that another inventory declares
        kPropertyDeclared,     ///< a property that another inventory declares
        kClassRespelled,       ///< a class got another inventory's letter case
        kPropertyRespelled,    ///< a property got another inventory's letter case
        kOperatingSystemMade,  ///< the inventory had no instance of KALMO_OperatingSystem
        kTypeDiffers,          ///< a property has another type than in `source`: its values count as equal only where both are null
        kKeysDiffer            ///< a class has other keys than in `source`: nothing matches unless rules exclude those
    };

    EKind kind;
    std::size_t inventory;  ///< the one that was changed, or differs
    std::size_t source;     ///< the one whose declaration counts; `inventory` itself for kOperatingSystemMade
    std::string className;
    std::string property;  ///< empty where the note is about a class
    std::string before;    ///< the spelling before; empty where nothing was respelled
};

}  // namespace NORVZEL20
