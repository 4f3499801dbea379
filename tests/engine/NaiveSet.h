#pragma once

#include <map>
#include <string>
#include <utility>
#include <vector>

namespace NORVZEL20 {

// Namespaces and rules as plain data, without any type of the host or the plug-in.

struct TNaiveMember;

/// A value: null, something that one text says, a list of texts, a path or an embedded object.
struct TNaiveValue {
    enum class EKind {
        kBoolean,
        kUint8,
        kSint8,
        kUint16,
        kSint16,
        kUint32,
        kSint32,
        kUint64,
        kSint64,
        kReal32,
        kReal64,
        kChar,  ///< one ASCII character
        kText,
        kTime,  ///< a point in time or an interval, in 25 characters
        kList,
        kPath,
        kObject  ///< an embedded instance
    };

    EKind kind = EKind::kText;
    bool isNull = true;
    std::string text;                   // as it was written; of a path and of an object: the class
    std::vector<std::string> list;      // of a path: the one namespace, if it has one
    std::vector<TNaiveMember> members;  // of a path: its keys; of an object: its properties
};

/// A named part of a path or an object.
struct TNaiveMember {
    std::string name;
    TNaiveValue value;
};

struct TNaiveProperty {
    std::string name;
    TNaiveValue::EKind kind;
    bool isKey;
};

struct TNaiveClass {
    std::string name;
    std::string superName;                   // empty: a top-level class
    std::vector<TNaiveProperty> properties;  // without inherited ones
};

struct TNaiveInstance {
    std::string className;
    std::map<std::string, TNaiveValue> values;  // a missing one is null
    std::string path;                           // as it was added; filled by the comparison
};

struct TNaiveNamespace {
    std::vector<TNaiveClass> classes;  // superclasses first
    std::vector<TNaiveInstance> instances;
};

/// One "class" element of a specification.
struct TNaiveElement {
    enum class EDefault { kNone, kInclude, kExclude };

    std::string className;
    EDefault def = EDefault::kNone;
    std::vector<std::string> excludedKeys;
    std::vector<std::pair<std::string, bool>> listed;  // name, and whether it is included; in the order of the document
};

struct TNaiveSet {
    std::vector<TNaiveNamespace> namespaces;
    std::vector<TNaiveElement> rules;
    bool areListsBags = false;  // whether the host compares lists without regard to order
};

}  // namespace NORVZEL20
