#pragma once

#include <memory>
#include <string>
#include <vector>

namespace NORVZEL20 {

struct TMofInstance;

/// A value as a document writes it. What it is depends on the type that is declared for it: see TMofTyping.
struct TMofValue {
    enum EKind : unsigned char {
        kNull,
        kBoolean,    ///< text is TRUE or FALSE
        kInteger,    ///< text is the number in decimal
        kReal,       ///< text is the number
        kCharacter,  ///< text is the character in UTF-8
        kText,
        kAlias,   ///< text is the name of an alias, without its dollar sign
        kObject,  ///< `object` is an instance that stands as a value
        kArray    ///< `elements` are its elements; none is an array
    };

    EKind kind = kNull;
    std::string text;
    std::vector<TMofValue> elements;
    std::shared_ptr<const TMofInstance> object;
};

}  // namespace NORVZEL20
