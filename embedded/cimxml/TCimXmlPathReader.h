#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "embedded/cimxml/TCimXmlAttributes.h"
#include "embedded/cimxml/TCimXmlContext.h"
#include "embedded/store/TInMemNamespace.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

/// Puts object paths together while their elements are read; a key may itself be a path, so paths nest.
///
/// Paths that stay within the document's own namespace come without one. Key values get the declared type of their key where the
/// class is known and nothing is lost.
class TCimXmlPathReader {
  public:
    /// `ns` (may be null) is where classes are looked up.
    TCimXmlPathReader(TCimXmlContext& context, boost::shared_ptr<TInMemNamespace> ns);

    /// Begins a path within the innermost. Errors: fails with status 9 where paths stand in each other too deeply.
    void Begin();
    /// Ends the innermost path. Errors: fails with status 9 where it has no class.
    TCIMReference End();
    /// Ends the innermost path without making one of it.
    void Drop() noexcept { --fDepth; }

    void BeginNamespacePath();
    void AddNamespace(const char* name);
    void SetHost(std::string_view host);
    /// To be called at the end of the element; where no path is open, the namespace is the document's own.
    void EndNamespacePath();

    void SetClassName(const char* name);
    void BeginKeyBinding(const char* name);
    void EndKeyBinding();
    void BeginKeyValue(const TCimXmlAttributes& attributes);
    void EndKeyValue(std::string_view text);
    void AddKey(TCIMValue value);

    /// The keys of the object's own name, read before the object, by name; valid until the next Begin.
    const std::vector<std::pair<std::string, TCIMValue>>& GetOwnKeys() const noexcept { return fFrames.front().keys; }
    bool HasOwnPath() const noexcept { return fDepth > 0 && !fFrames.front().className.empty(); }
    /// Takes the document's namespace from the object's own name.
    void NoteOwnNamespace();

    /// Whether End met a class that is not declared since this was last asked.
    bool TakeMetUnknownClass() noexcept { return std::exchange(fMetUnknownClass, false); }
    /// For paths that another reader has read.
    void NoteUnknownClass() noexcept { fMetUnknownClass = true; }

  private:
    struct TFrame {
        std::string namespaceName;
        std::string host;
        std::string className;
        std::string keyName;       // of the KEYBINDING that is open and has no value yet
        bool isInBinding = false;  // one is open
        std::vector<std::pair<std::string, TCIMValue>> keys;
    };

    boost::shared_ptr<TInMemClass> FindClass(const std::string& name);
    TCIMValue ReadKey(std::string_view text);
    void AddKeyTo(TCIMReference& path, const std::string& name, const TCIMValue& value) const;
    [[noreturn]] void FailTooDeep() const;
    const std::string& FindOnlyKey(const TInMemClass* cls) const;

    TCimXmlContext& fContext;
    boost::shared_ptr<TInMemNamespace> fNamespace;
    boost::shared_ptr<TInMemClass> fLastClass;
    std::vector<TFrame> fFrames;  // kept for their memory; fDepth of them are open
    std::size_t fDepth = 0;
    std::string fNamespaceName;
    std::string fHost;
    std::string fValueType;
    std::string fType;
    bool fMetUnknownClass = false;
};

}  // namespace NORVZEL20
