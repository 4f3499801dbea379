#pragma once

#include <optional>
#include <string>

#include "embedded/cimxml/TCimXmlAttributes.h"
#include "embedded/load/TDraft.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/load/TLoadPlace.h"

namespace NORVZEL20 {

/// Puts the draft of a class or an instance together while its elements are read.
///
/// Order of calls: BeginClass or BeginInstance, the parts in the order in which they nest, Take.
/// Errors: every operation fails through the context, with kParseError (9) if an attribute is missing or wrong, a property comes
/// twice, or there are more parts than TSchemaLimits allows.
class TCimXmlDraftBuilder {
  public:
    explicit TCimXmlDraftBuilder(TLoadContext& context) : fContext(context) {}

    void BeginClass(const TCimXmlAttributes& attributes);
    void BeginInstance(const char* className);
    /// Ends the class or instance.
    TDraft Take();

    /// The value, and with it the type, comes at the end.
    void BeginProperty(const char* name, const TCimXmlAttributes& attributes);
    /// The name of the property that is open; valid until it ends.
    const std::string& GetPropertyName() const noexcept { return fProperty->name; }
    void EndProperty(TCIMValue value);
    /// Notes that the value of the property that is open is bad; it then ends with a null.
    void AddBadValue(TBadValue bad);
    /// The class or instance that is open.
    const TEmbeddedObject& GetObject() const noexcept { return fDraft->object; }
    void BeginMethod(const TCimXmlAttributes& attributes);
    void EndMethod();
    void BeginParameter(const TCimXmlAttributes& attributes);
    void EndParameter();
    /// Puts it on the innermost element that is open.
    void AddQualifier(TEmbeddedObject::TQualifier qualifier);

  private:
    void CheckRoom(std::size_t count, std::size_t most, const char* what) const;
    unsigned int ReadArraySize(const TCimXmlAttributes& attributes) const;

    TLoadContext& fContext;
    std::optional<TDraft> fDraft;
    std::optional<TEmbeddedObject::TProperty> fProperty;
    TLoadPlace fPropertyPlace;
    std::optional<TEmbeddedObject::TMethod> fMethod;
    std::optional<TEmbeddedObject::TParameter> fParameter;
};

}  // namespace NORVZEL20
