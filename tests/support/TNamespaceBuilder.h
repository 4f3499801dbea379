#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <utility>
#include <vector>

#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// Fills any namespace with classes and instances, through the host's interfaces only.
class TNamespaceBuilder {
  public:
    /// A property to declare.
    struct TProperty {
        std::string name;
        TCIMValue::TCIMType::ECIMType type;
        bool isKey;
    };
    using TValues = std::vector<std::pair<std::string, TCIMValue>>;

    static TProperty Key(const std::string& name, TCIMValue::TCIMType::ECIMType type = TCIMValue::TCIMType::kString);
    static TProperty Property(const std::string& name, TCIMValue::TCIMType::ECIMType type = TCIMValue::TCIMType::kString);

    explicit TNamespaceBuilder(boost::shared_ptr<ICIMNamespace> ns);

    boost::shared_ptr<ICIMNamespace> GetNamespace() const { return fNamespace; }

    /// Declares a class; an empty `superName` makes a top-level one.
    TNamespaceBuilder& Class(const std::string& name, const std::string& superName, const std::vector<TProperty>& properties);
    /// Adds an instance. Properties that `values` does not name stay null.
    TNamespaceBuilder& Instance(const std::string& className, const TValues& values);
    /// Declares KALMO_OperatingSystem and adds one instance with this OSType.
    TNamespaceBuilder& OperatingSystem(unsigned short osType = 36);
    /// Declares the three classes of delta records.
    TNamespaceBuilder& DeltaSchema();

  private:
    boost::shared_ptr<ICIMQualifierDecl> KeyDecl();

    boost::shared_ptr<ICIMNamespace> fNamespace;
};

}  // namespace NORVZEL20
