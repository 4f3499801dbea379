#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "embedded/cimxml/TCimXmlAttributes.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/store/TInMemNamespace.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

/// Puts object paths together while their elements are read. A key may be a path itself, so paths nest.
///
/// A path that is known to stay within the document's own namespace comes without a namespace. If the class is declared, a key
/// value gets the declared type of its key, unless that would lose something. Errors: every operation fails through the context,
/// with kParseError (9) if the path is not well-formed and kTypeMismatch (13) if a key's text is no value of its type.
class TCimXmlPathReader {
  public:
    /// Classes are looked up in `ns` (may be null). `context` must outlive the reader.
    TCimXmlPathReader(TLoadContext& context, boost::shared_ptr<const TInMemNamespace> ns);

    /// Begins a path inside of the innermost one. Errors: kParseError (9) if paths are nested too deeply.
    void Begin();
    /// Ends the innermost path. Errors: kParseError (9) if it has no class, or a key twice.
    TCIMReference End();
    /// Ends the innermost path and forgets it.
    void Drop() noexcept { --fDepth; }

    void BeginNamespacePath();
    void AddNamespace(const char* name);
    void SetHost(std::string_view host);
    /// Ends NAMESPACEPATH or LOCALNAMESPACEPATH. If no path is open, the namespace is the document's own.
    void EndNamespacePath();

    void SetClassName(const char* name);
    void BeginKeyBinding(const char* name);
    void EndKeyBinding();
    void BeginKeyValue(const TCimXmlAttributes& attributes);
    void EndKeyValue(std::string_view text);
    void AddKey(TCIMValue value);

    /// The keys of the name in front of the object, each with its own name; valid until the next Begin.
    const std::vector<std::pair<std::string, TCIMValue>>& GetOwnKeys() const noexcept { return fFrames.front().keys; }
    /// Whether there is a name in front of the object that is open.
    bool HasOwnPath() const noexcept { return fDepth > 0 && !fFrames.front().className.empty(); }
    /// Checks that the name in front of the object, if there is one, is of that class. Errors: kParseError (9) if it is not.
    void CheckOwnClass(const char* className) const;
    /// Takes the document's namespace from the name in front of the object, if it has one.
    void NoteOwnNamespace();

    /// Whether a path that has ended since the last call may have to be written again at the end of the document: its class is not
    /// declared, or it is open (see TOwnPlaceSearch).
    bool TakeMetUnsettled() noexcept { return std::exchange(fMetUnsettled, false); }
    /// Reports such a path that another reader has read.
    void NoteUnsettled() noexcept { fMetUnsettled = true; }

  private:
    struct TFrame {
        std::string namespaceName;
        std::string host;
        std::string className;
        std::string keyName;       // of the open KEYBINDING, until it has its value
        bool isInBinding = false;  // a KEYBINDING is open
        std::vector<std::pair<std::string, TCIMValue>> keys;
    };

    boost::shared_ptr<TInMemClass> FindClass(const std::string& name);
    TCIMValue ReadKey(std::string_view text);
    TCIMValue SettleBadKey(const TBadValue& bad);
    void SetPlace(TCIMReference& path, const TFrame& frame);
    const std::string& FindOnlyKey(const TInMemClass* cls) const;

    TLoadContext& fContext;
    boost::shared_ptr<const TInMemNamespace> fNamespace;
    boost::shared_ptr<TInMemClass> fLastClass;
    std::vector<TFrame> fFrames;  // kept for their memory; fDepth of them are open
    std::size_t fDepth = 0;
    std::string fNamespaceName;
    std::string fHost;
    std::string fValueType;
    std::string fType;
    bool fMetUnsettled = false;
};

}  // namespace NORVZEL20
