#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "embedded/load/TLoadReport.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// A namespace and the documents that are loaded into it, for tests. Also makes the elements of such documents.
class TLoading {
  public:
    TLoading();

    /// Loads the text. Messages call it "doc.xml".
    TLoadReport Load(const std::string& document);
    TLoadReport LoadFile(const std::string& path);
    /// The message when the text cannot be loaded; "" if it can.
    std::string ErrorOf(const std::string& document);
    /// The status of that failure; 0 if the text can be loaded.
    int StatusOf(const std::string& document);

    /// The value of a property of an instance, as text; both must exist.
    std::string ValueOf(const std::string& path, const std::string& property) const;
    boost::shared_ptr<ICIMInstance> Find(const std::string& path) const;
    /// The paths of the instances of a class, a line for each.
    std::string PathsOf(const std::string& className) const;
    /// The whole namespace as CIM-XML. It names the namespace that was known of the last document.
    std::string Write() const;

    const boost::shared_ptr<TInMemNamespace>& GetNamespace() const { return fNamespace; }

    /// A document with the given contents of its DECLGROUP.
    static std::string Group(const std::string& contents);
    /// A class `name` with the string key Id and further property elements.
    static std::string Class(const std::string& name, const std::string& properties = std::string());
    /// An instance with the key Id and further property elements.
    static std::string Instance(const std::string& className, const std::string& id, const std::string& properties = std::string());
    static std::string Property(const std::string& name, const std::string& type, const std::string& value);
    static std::string Array(const std::string& name, const std::string& type, const std::vector<std::string>& values);
    /// The tolerated lines, one below the other.
    static std::string Tolerated(const TLoadReport& report);

  private:
    TLoadReport Keep(TLoadReport report);

    boost::shared_ptr<TInMemNamespace> fNamespace;
    std::string fName;
};

}  // namespace NORVZEL20
