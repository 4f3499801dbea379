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

/// One comparison of several namespaces: made, asked to compare() and dropped. TDeltaNamespace::FindDifferences is the usual way.
///
/// The first namespace is the reference: each other one is compared with it, class by class in the reference's class tree,
/// instance by instance under their keys, property by property as the rules say. What differs is written into the delta
/// namespace as it is found. Every host call carries an empty call context, save those that record an alias.
///
/// Threads: one; the host's objects are called synchronously.
/// Errors: TZELException with the statuses named here; exceptions of the host's objects as they are. Nothing is undone.
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
    /// Rules for a class flow down to its subclasses in the schema. What is read first matters: an ancestor's rules that come
    /// after a subclass's own replace them. Written by one thread while a specification is read, and only read afterwards.
    class TRuleset {
      public:
        /// The rules of the class; where there are none, new ones that exclude everything and are not kept. Never null.
        boost::shared_ptr<TDiffClassRules> getClassRules(std::string className);

        /// Adds rules for a class, or merges them into those that it has.
        ///
        /// The first ones are copied. Later ones are merged by TDiffClassRules::updateRules, unless rules that were added
        /// explicitly have been merged before: those are final. `rules` must not be null.
        void addToRuleset(std::string className, boost::shared_ptr<TDiffClassRules> rules, bool isExplicit);

        /// Adds the parent's rules to the class (an empty `parentName`: adds none), then the class's to its subclasses in
        /// `schema`, direct and indirect, parents first.
        ///
        /// Errors: those of the schema; what was added until then stays. Cost: one GetClass and one enumeration for each class.
        void updateRuleset(std::string className, std::string parentName, boost::shared_ptr<ICIMNamespace> schema);

        /// Writes names, defaults and listed properties to standard output, for diagnosis.
        void print();

        std::map<std::string, boost::shared_ptr<TDiffClassRules>> fRules;
    };

    /// "INCLUDE" for 0, "EXCLUDE" for everything else.
    static std::string strPropType(propType type);

    /// Checks the operating systems and reads the specification file.
    ///
    /// With exactly one namespace, or where the file name contains "|fVMWareEnable", neither happens and there are no rules.
    /// `namespaces` is kept by reference and must outlive the engine. Each namespace must hold KALMO_OperatingSystem, and the
    /// reference an instance of it with a numeric OSType; the values of the others do not matter.
    /// Errors: status 3 where that is not so, whatever the cause and without any namespace too, after one entry in the core log,
    /// or two where the reference's OSType changes meanwhile; those of ReadSpecFile.
    TCIMDiffEngine(boost::shared_ptr<ICIMNamespace> deltaNamespace, std::vector<boost::shared_ptr<ICIMNamespace>>& namespaces,
                   std::string specFileName);

    /// Compares every class of the reference, parents before children. Errors: as compare(cls); std::out_of_range without any
    /// namespace.
    void compare();

    /// Compares the instances of one class of the reference, and of all classes below it.
    ///
    /// With exactly two namespaces the reference takes over the other one's values and instances on the way.
    /// Errors: status 37, after one entry in the core log, where another namespace lacks a class of which the reference has
    /// instances; any other status of a host call.
    void compare(boost::shared_ptr<ICIMClass> cls);

    /// Compares two instances with the same key. Each property that differs is entered into `differences`, under `key` and its
    /// name, with `namespaceIndex`; with exactly two namespaces the master also gets the other one's value.
    void compare(boost::shared_ptr<TDiffClassRules> rules, boost::shared_ptr<ICIMInstance> master,
                 boost::shared_ptr<ICIMInstance> other, std::string key, std::vector<std::string>& properties,
                 std::map<std::string, std::map<std::string, std::vector<int>>>& differences, unsigned int namespaceIndex);

    /// The names of the properties to compare: the included ones in ascending order where the default is to exclude, else all that
    /// the class declares, in its order, without the excluded ones and the collection time.
    std::vector<std::string> buildPropList(boost::shared_ptr<TDiffClassRules> rules, boost::shared_ptr<ICIMClass> cls);

    /// Enters each instance under its key; of several with the same key the first one stays.
    void buildInstanceMap(boost::shared_ptr<TDiffClassRules> rules, std::vector<boost::shared_ptr<ICIMInstance>>& instances,
                          std::map<std::string, TMasterInstance>& masterMap);

    /// The key under which an instance is matched: the text of a path of its class and its keys, excluded ones left out, without a
    /// namespace.
    std::string buildPath(boost::shared_ptr<TDiffClassRules> rules, boost::shared_ptr<ICIMInstance> instance);

    /// The same for an object path; where the rules exclude no key, the path's text as it is, namespace included.
    std::string buildPath(boost::shared_ptr<TDiffClassRules> rules, const TCIMReference& path);

    /// Writes one KALMO_Delta and its association with the class record into the delta namespace. Each index is cut to 16 bits.
    ///
    /// The delta schema must declare both classes and all their properties; a null handle fails the host's assertion.
    void createCIMDiff(boost::shared_ptr<ICIMInstance> deltaClassRecord, TDeltaNamespace::EDeltaType type, std::string instanceName,
                       std::string propertyName, std::vector<int> namespaceIndices);

    /// Notes `path` under `alias` on the delta namespace's wrapper of the class in the namespace at `nsIndex`; the first path of an
    /// alias stays. A class that is not wrapped fails the host's assertion.
    void createObjectPathAlias(std::string className, std::string alias, const TCIMReference& path, unsigned int nsIndex);

    /// Reads a specification file of at most 104,857,600 bytes, validated against the first namespace.
    ///
    /// Errors: status 9 where the file is larger (before it is opened) or wrong, with two entries in the core log for what the
    /// grammar or the schema does not know and one for malformed XML; 4 without memory for it; 11 where it cannot be opened or
    /// read (a file whose reading failed stays open); any other status of the schema, with one entry, or of the host's file
    /// size; std::out_of_range without any namespace.
    TRuleset ReadSpecFile(const std::string& fileName);

  private:
    friend struct TTestAccess;
    class TClassComparison;

    void CheckOperatingSystems();
    void CompareSubClasses(ICIMClass& cls);
    void AliasInstance(ICIMInstance& instance, const std::string& key, unsigned int namespaceIndex);
    bool IsDifferent(boost::shared_ptr<TDiffClassRules> rules, const TCIMValue& master, const TCIMValue& other);
    boost::shared_ptr<ICIMInstance> AllocateRecord(const std::string& className);
    static void SetProperty(ICIMInstance& instance, const std::string& name, const TCIMValue& value);

    boost::shared_ptr<ICIMNamespace> deltaNamespace;
    std::vector<boost::shared_ptr<ICIMNamespace>>& namespaces;  // position 0 is the reference
    TRuleset ruleset;
};

}  // namespace NORVZEL20
