#pragma once

#include <map>
#include <string>
#include <utility>
#include <vector>

namespace NORVZEL20 {

// Namespaces and rules as plain data, without any type of the host or the plug-in.

/// A value: null, a number, a text, a list of texts or a path.
struct TNaiveValue {
    enum class EKind { kNumber, kText, kList, kPath };

    EKind kind = EKind::kText;
    bool isNull = true;
    unsigned int number = 0;
    std::string text;                                           // of a path: the class
    std::vector<std::string> list;                              // of a path: the one namespace, where there is one
    std::vector<std::pair<std::string, std::string>> pathKeys;  // of a path, all of them texts
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
