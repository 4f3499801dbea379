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
        kPropertyRespelled,    ///< a property got the letter case of another inventory, or that of kCollectionTime
        kOperatingSystemMade,  ///< the inventory had no instance of KALMO_OperatingSystem
        kTypeDiffers,          ///< a property has another type than in `source`: values are equal only if both are null
        kKeysDiffer,           ///< a class has other keys than in `source`: no instances match, unless the rules exclude those keys
        kArrayTypeDiffers,     ///< an array is a bag here and not in `source`, or the other way round; `source` decides
        kSuperClassDiffers,    ///< a class has another superclass than in `source`; rules follow the tree of `source`
        kSpellingDiffers       ///< a class or key has another letter case than in `source`, and was left so: no instances match
    };

    EKind kind;
    std::size_t inventory;  ///< the position of the inventory that was changed or differs
    std::size_t source;     ///< the position of the inventory whose declaration was taken; `inventory` itself if the client decided
    std::string className;
    std::string property;                  ///< empty if the note is about a class
    std::string before;                    ///< of a note about spelling: the one in `inventory`, before a change; else empty
    std::string declared = std::string();  ///< of kArrayTypeDiffers and kSuperClassDiffers: what `inventory` declares
    std::string declaredInSource = std::string();  ///< likewise, in `source`; a top-level class has an empty superclass
};

}  // namespace NORVZEL20
