#pragma once

#include <cstddef>
#include <string>

namespace NORVZEL20 {

/// A change of an inventory's schema that makes it comparable, or a difference that cannot be reconciled.
struct TSchemaNote {
    enum EKind {
        kClassDeclared,        ///< a class that another inventory declares
        kPropertyDeclared,     ///< a property that another inventory declares
        kClassRespelled,       ///< a class got the letter case of another inventory
        kPropertyRespelled,    ///< a property got the letter case of another inventory
        kOperatingSystemMade,  ///< the inventory had no instance of KALMO_OperatingSystem
        kTypeDiffers,          ///< a property has another type than in `source`: values are equal only if both are null
        kKeysDiffer            ///< a class has other keys than in `source`: no instances match, unless the rules exclude those keys
    };

    EKind kind;
    std::size_t inventory;  ///< the position of the inventory that was changed or differs
    std::size_t source;  ///< the position of the inventory whose declaration was taken; `inventory` itself for kOperatingSystemMade
    std::string className;
    std::string property;  ///< empty if the note is about a class
    std::string before;    ///< the spelling before, of a note about spelling; else empty
};

}  // namespace NORVZEL20
