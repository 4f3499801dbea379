#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <map>
#include <string>
#include <vector>

#include "host/Export.h"
#include "host/ICIMClass.h"
#include "host/ICIMInstance.h"
#include "host/ICIMNamespace.h"
#include "host/TCIMReference.h"
#include "provider/TDeltaNamespace.h"

namespace NORVZEL20 {

/// One comparison of several namespaces. Make it, call compare() and drop it, as TDeltaNamespace::FindDifferences does.
///
/// The first namespace is the reference. Every other namespace is compared with it: class by class down the reference's class
/// tree, instance by instance by their keys, property by property as the rules say. Each class's differences are written into the
/// delta namespace before the next class is visited. Every host call has an empty call context, except those that record an alias.
///
/// Threads: use an engine from one thread. The host's objects are called from that thread.
/// Errors: TZELException with the statuses named here, and the exceptions of the host's objects, unchanged. What was written before
/// an error stays.
class CIMDELTA_INTERNAL_EXPORT TCIMDiffEngine {
  public:
    /// How a comparison treats a property.
    enum propType {
        INCLUDE = 0,  ///< it is compared
        EXCLUDE = 1   ///< it is ignored
    };

    class TDiffClassRules;    // spec/TDiffClassRules.h: the rules for one class
    class TDiffXMLParser;     // spec/TDiffXMLParser.h: reads a specification
    class TMasterInstance;    // engine/TMasterInstance.h: an instance of the reference
    class TCompareInstances;  // engine/TCompareInstances.h: takes one namespace's instances

    /// The rules of all classes, by class name (byte for byte). Copies share the rules.
    ///
    /// Rules for a class also apply to its subclasses in the schema. Their order counts: rules for an ancestor that are read after
    /// a subclass's own rules prevail over them. One thread writes a ruleset while it reads a specification; afterwards any thread
    /// may read it.
    class TRuleset {
      public:
        /// The rules of the class, or new rules that exclude everything if the ruleset has none. The new ones are not kept. Never
        /// null.
        boost::shared_ptr<TDiffClassRules> getClassRules(std::string className);

        /// Adds rules for a class, or merges them into those that it has.
        ///
        /// The first rules of a class are copied. Later ones are merged into them with TDiffClassRules::updateRules. The first
        /// merge with `isExplicit` makes the class's rules final: from then on they stay as they are. `rules` must not be null.
        void addToRuleset(std::string className, boost::shared_ptr<TDiffClassRules> rules, bool isExplicit);

        /// Adds the rules of the parent to the class, then those of the class to its subclasses in `schema`, direct and indirect,
        /// parents first. If `parentName` is empty, nothing is added to the class itself.
        ///
        /// Errors: those of the schema; what was added before stays. Cost: one GetClass and one enumeration for each class.
        void updateRuleset(std::string className, std::string parentName, boost::shared_ptr<ICIMNamespace> schema);

        /// Writes class names, defaults and listed properties to standard output, for diagnosis.
        void print();

        std::map<std::string, boost::shared_ptr<TDiffClassRules>> fRules;
    };

    /// "INCLUDE" for INCLUDE, "EXCLUDE" for any other value.
    static std::string strPropType(propType type);

    /// Checks the operating systems and reads the specification file.
    ///
    /// With exactly one namespace, or if the file name contains "|fVMWareEnable", neither happens and there are no rules.
    /// `namespaces` is kept by reference and must outlive the engine. Each namespace must have the class KALMO_OperatingSystem, and
    /// the reference an instance of it with a numeric OSType. The other namespaces' values do not matter.
    /// Errors: kInitializationFailed (3) if any of that is missing or cannot be read, or if there is no namespace, after one entry
    /// in the core log (two entries if the reference's OSType changes during the check); those of ReadSpecFile.
    TCIMDiffEngine(boost::shared_ptr<ICIMNamespace> deltaNamespace, std::vector<boost::shared_ptr<ICIMNamespace>>& namespaces,
                   std::string specFileName);

    /// Compares every class of the reference, parents before children. Errors: as compare(cls); std::out_of_range if there is no
    /// namespace.
    void compare();

    /// Compares the instances of one class of the reference, and then of all classes below it.
    ///
    /// With exactly two namespaces, the reference takes over the other namespace's values and instances during the comparison.
    /// Errors: kSchemaMismatch (37), after one entry in the core log, if another namespace lacks a class of which the reference has
    /// instances; any other status of a host call.
    void compare(boost::shared_ptr<ICIMClass> cls);

    /// Compares two instances with the same key. For each property that differs, `namespaceIndex` is appended to `differences`
    /// under `key` and the property's name. With exactly two namespaces, `master` also takes over the value of `other`.
    void compare(boost::shared_ptr<TDiffClassRules> rules, boost::shared_ptr<ICIMInstance> master,
                 boost::shared_ptr<ICIMInstance> other, std::string key, std::vector<std::string>& properties,
                 std::map<std::string, std::map<std::string, std::vector<int>>>& differences, unsigned int namespaceIndex);

    /// Whether two values of a property differ: references by the texts of their paths (see buildPath), all other values by
    /// TCIMValue::operator==. The type is that of `master`, the reference's value.
    /// Errors: kTypeMismatch (13) if `master` is a path and `other` has another type and is not null.
    bool IsDifferent(const boost::shared_ptr<TDiffClassRules>& rules, const TCIMValue& master, const TCIMValue& other);

    /// The names of the properties to compare. If the default is to exclude: the included properties, in ascending order. If it is
    /// to include: all properties of the class in the class's order, without the excluded ones and DateTimeOfCollection.
    std::vector<std::string> buildPropList(boost::shared_ptr<TDiffClassRules> rules, boost::shared_ptr<ICIMClass> cls);

    /// Enters each instance into `masterMap` under its key. Of several instances with the same key, the first one stays.
    void buildInstanceMap(boost::shared_ptr<TDiffClassRules> rules, std::vector<boost::shared_ptr<ICIMInstance>>& instances,
                          std::map<std::string, TMasterInstance>& masterMap);

    /// The key under which an instance is matched: the text of a path with its class and its keys that are not excluded, without a
    /// namespace.
    std::string buildPath(boost::shared_ptr<TDiffClassRules> rules, boost::shared_ptr<ICIMInstance> instance);

    /// The same for an object path. If the rules exclude no key, it is the text of the path itself, including its namespace.
    std::string buildPath(boost::shared_ptr<TDiffClassRules> rules, const TCIMReference& path);

    /// Writes one KALMO_Delta and its association with the class record into the delta namespace. Each index is cut to 16 bits.
    ///
    /// The delta schema must declare both classes and all their properties. Errors: a null handle fails the host's assertion.
    void createCIMDiff(boost::shared_ptr<ICIMInstance> deltaClassRecord, TDeltaNamespace::EDeltaType type, std::string instanceName,
                       std::string propertyName, std::vector<int> namespaceIndices);

    /// Notes `path` under `alias` on the delta namespace's wrapper of the class in the namespace at `nsIndex`. An alias that exists
    /// keeps its path. Errors: a class that the delta namespace does not wrap fails the host's assertion.
    void createObjectPathAlias(std::string className, std::string alias, const TCIMReference& path, unsigned int nsIndex);

    /// Reads a specification file of at most kMaxSpecFileSize bytes and validates it against the first namespace.
    ///
    /// Errors:
    /// - kParseError (9) if the file is larger; it is then not opened, and nothing is logged.
    /// - kParseError (9) if the file is wrong: with two entries in the core log if the grammar or the schema does not know a name,
    ///   with one entry for malformed XML.
    /// - kOutOfMemory (4) if there is no memory for the file's text.
    /// - kFileError (11) if the file cannot be opened or read. A file that cannot be read to its end stays open.
    /// - Any other status of the schema, with one entry, and the host's errors for the file's size.
    /// - std::out_of_range if there is no namespace.
    TRuleset ReadSpecFile(const std::string& fileName);

  private:
    friend struct TTestAccess;
    class TClassComparison;
    class TInstanceWalk;

    void CheckOperatingSystems();
    void CompareSubClasses(ICIMClass& cls);
    void AliasInstance(ICIMInstance& instance, const std::string& key, unsigned int namespaceIndex);
    boost::shared_ptr<ICIMInstance> AllocateRecord(const std::string& className);
    static void SetProperty(ICIMInstance& instance, const std::string& name, const TCIMValue& value);

    boost::shared_ptr<ICIMNamespace> deltaNamespace;
    std::vector<boost::shared_ptr<ICIMNamespace>>& namespaces;  // position 0 is the reference
    TRuleset ruleset;
};

}  // namespace NORVZEL20
