#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "embedded/cimxml/TLoadReport.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// A namespace, and documents loaded into it.
class TLoading {
  public:
    TLoading();

    /// Loads the text, which is called "doc.xml" in messages.
    TLoadReport Load(const std::string& document);
    TLoadReport LoadFile(const std::string& path);
    /// The message of the failure to load the text, or "" where it loads.
    std::string ErrorOf(const std::string& document);
    /// The status of that failure.
    int StatusOf(const std::string& document);

    /// The value as ICIMProperty delivers it, as text; "no such instance" and the like where there is none.
    std::string ValueOf(const std::string& path, const std::string& property) const;
    boost::shared_ptr<ICIMInstance> Find(const std::string& path) const;
    /// The paths of the instances of a class, a line for each.
    std::string PathsOf(const std::string& className) const;
    /// The whole namespace as CIM-XML.
    std::string Write() const;

    const boost::shared_ptr<TInMemNamespace>& GetNamespace() const { return fNamespace; }

    /// A document with the given contents of its DECLGROUP.
    static std::string Group(const std::string& contents);
    /// A class `name` with the string key Id and further property elements.
    static std::string Class(const std::string& name, const std::string& properties = std::string());
    /// An instance with the key Id and further property elements.
    static std::string Instance(const std::string& className, const std::string& id, const std::string& properties = std::string());
    static std::string Property(const std::string& name, const std::string& type, const std::string& value);
    /// The tolerated lines, one below the other.
    static std::string Tolerated(const TLoadReport& report);

  private:
    boost::shared_ptr<TInMemNamespace> fNamespace;
};

}  // namespace NORVZEL20
