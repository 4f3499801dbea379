#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <map>
#include <string>
#include <utility>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

class ICIMClass;
class ICIMNamespace;

/// An object path: the namespace that it belongs to, a class and a set of key bindings (DSP0004, 8.2 "Identifying CIM objects").
///
/// A value type; copies share their contents until one of them is changed, so copying allocates nothing. The namespace is held
/// weakly, so that a namespace may store references into itself; its name is kept. The class is held.
/// Threads: distinct objects may be used at once, also when they share contents.
class TCIMReference {
  public:
    /// A path without namespace, class and keys; its text is empty.
    TCIMReference();
    /// A path in `ns` (null: in no namespace) with the given bindings and no class yet.
    TCIMReference(boost::shared_ptr<ICIMNamespace> ns, std::map<std::string, TCIMValue> keys);
    TCIMReference(const TCIMReference& other) noexcept;
    TCIMReference& operator=(const TCIMReference& other) noexcept;
    ~TCIMReference();

    /// Adds one binding. A name that is bound already (in whatever letter case) gets the new value and keeps its place.
    /// Errors: status 5 where references stand more than twelve deep in one another's bindings.
    void AddKeyValue(const std::string& name, const TCIMValue& value);

    /// Calls `callback` for each binding, as a (name, value) pair, in the order of GetPath, until it returns false.
    void EnumerateKeyBindings(const boost::function<bool(std::pair<std::string, TCIMValue>)>& callback) const;

    /// The class; for a class that nobody declared a stub of that name without properties; null only where none was ever set.
    boost::shared_ptr<ICIMClass> GetClass() const;
    /// Null takes the class away.
    void SetClass(boost::shared_ptr<ICIMClass> cls);

    /// The path's text: `root/cimv2:Class.Key1="v",Key2=5` (DSP0207, untyped, without authority).
    ///
    /// Without a namespace `Class.Key1="v",Key2=5`, without keys `Class`; a host stands in front as `//host/root/cimv2:...`.
    /// Bindings in ascending order of their names (compared in lower case), names as declared; text and datetimes in double
    /// quotes with `\` and `"` escaped by `\`; char16 in single quotes with `\` and `'` escaped; TRUE and FALSE; references as
    /// quoted path text; reals in their shortest exact form; null as NULL. One pass, one buffer.
    std::string GetPath() const;
    /// The same text, appended to `out`.
    void AppendPath(std::string& out) const;

    /// The namespace, or null where there is none or it is gone.
    boost::shared_ptr<ICIMNamespace> GetNamespace() const;
    /// Empty where there is none. Names are kept as written, slashes in front and behind taken off.
    const std::string& GetNamespaceName() const;
    void SetNamespaceName(const std::string& name);
    /// Empty where there is none.
    const std::string& GetHost() const;
    void SetHost(const std::string& host);
    /// The class's name; empty where there is none. Works for stubs too.
    const std::string& GetClassName() const;
    /// Gives the path a stub class of that name, to be used where the class is not at hand.
    void SetClassName(const std::string& name);
    std::size_t GetKeyCount() const;
    /// The value bound to `name` (letter case does not count), or null. Valid until the path is changed.
    const TCIMValue* FindKeyValue(const std::string& name) const;

    /// Reads a path's text, also with a slash or `//host/` in front (DSP0207), and `namespace:` missing or not.
    ///
    /// Bound text may carry any escaped character. Numbers become uint64, sint64 (with a sign) or real64; quoted text becomes a
    /// string. The store converts such values to a key's declared type when it looks a path up. `ns`, where it is not null, is the
    /// namespace whose declared class the path gets; otherwise, or where it has none, the class is a stub.
    /// Errors: TZELException with status 9 where the text is no path; `errorPosition`, where given, then holds the byte offset.
    static TCIMReference Parse(const std::string& text, boost::shared_ptr<ICIMNamespace> ns = boost::shared_ptr<ICIMNamespace>(),
                               std::size_t* errorPosition = nullptr);

  private:
    friend class TValueAccess;
    struct TContents;

    explicit TCIMReference(TContents* contents) noexcept;
    TContents& Own();
    /// The length of the path's text where nothing in it needs an escape.
    std::size_t EstimateLength() const;

    TContents* fContents;  // counted; null stands for the empty path
};

}  // namespace NORVZEL20
