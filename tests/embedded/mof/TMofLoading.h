#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <map>
#include <string>

#include "embedded/load/TLoadReport.h"
#include "embedded/mof/IMofIncludes.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// Files in memory that documents may include. A file's name is its identity.
class TMofFiles : public IMofIncludes {
  public:
    bool Find(const std::string& name, const std::string& from, TFile& file, std::string& reason) override;
    bool Read(const TFile& file, std::size_t most, std::string& bytes, std::string& reason) override;

    std::map<std::string, std::string> fTexts;  ///< by name
};

/// A namespace and the MOF that is loaded into it, for tests.
class TMofLoading {
  public:
    TMofLoading();

    /// From now on documents may include `text` as `name`.
    TMofLoading& File(const std::string& name, const std::string& text);

    /// Loads the text. Messages call it "doc.mof".
    TLoadReport Load(const std::string& document);
    /// The message when the text cannot be loaded; "" if it can.
    std::string ErrorOf(const std::string& document);
    /// The status of that failure; 0 if the text can be loaded.
    int StatusOf(const std::string& document);

    /// The value of a property of an instance, as text; both must exist.
    std::string ValueOf(const std::string& path, const std::string& property) const;
    TCIMValue RawValueOf(const std::string& path, const std::string& property) const;
    /// A class with what it declares itself, as CIM-XML.
    std::string ClassOf(const std::string& name) const;
    /// All instances as CIM-XML, a line for each.
    std::string Instances() const;
    /// The whole namespace as CIM-XML.
    std::string Write() const;

    const boost::shared_ptr<TInMemNamespace>& GetNamespace() const { return fNamespace; }

    /// The tolerated lines, one below the other.
    static std::string Tolerated(const TLoadReport& report);

  private:
    boost::shared_ptr<TInMemNamespace> fNamespace;
    boost::shared_ptr<TMofFiles> fFiles;
};

}  // namespace NORVZEL20
