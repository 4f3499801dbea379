#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <map>
#include <string>
#include <utility>

#include "host/Export.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

class ICIMClass;
class ICIMNamespace;

/// An object path: the namespace that it belongs to, a class and a set of key bindings (DSP0004, 8.2 "Identifying CIM objects").
///
/// A value type. Copies share their contents until one of them is changed, so copying allocates nothing. The path holds its class,
/// but its namespace only weakly, because a namespace may store references into itself. The namespace's name is kept.
/// Threads: different objects may be used concurrently, even if they share contents.
class CIMDELTA_EXPORT TCIMReference {
  public:
    /// A path without namespace, class and keys; its text is empty.
    TCIMReference();
    /// A path in `ns`, or in no namespace for null, with the given bindings and no class yet.
    /// Errors: as AddKeyValue.
    TCIMReference(boost::shared_ptr<ICIMNamespace> ns, std::map<std::string, TCIMValue> keys);
    TCIMReference(const TCIMReference& other) noexcept;
    TCIMReference& operator=(const TCIMReference& other) noexcept;
    ~TCIMReference();

    /// Adds one binding. A name that is bound already, in any letter case, gets the new value and keeps its spelling.
    /// Errors: kInvalidParameter (5) if references are nested more than twelve deep in one another's bindings.
    void AddKeyValue(const std::string& name, const TCIMValue& value);

    /// Calls `callback` with each binding, as a pair of name and value, in the order of GetPath, until it returns false.
    void EnumerateKeyBindings(const boost::function<bool(std::pair<std::string, TCIMValue>)>& callback) const;

    /// The class. A name that no namespace declared gives a stub: a class of that name without properties. Null if the path has no
    /// class.
    boost::shared_ptr<ICIMClass> GetClass() const;
    /// Null removes the class.
    void SetClass(boost::shared_ptr<ICIMClass> cls);

    /// The path's text: `root/cimv2:Class.Key1="v",Key2=5` (DSP0207, untyped, without authority).
    ///
    /// A path without a namespace is `Class.Key1="v",Key2=5`, one without keys `Class`, one with a host `//host/root/cimv2:...`.
    /// Bindings come in ascending order of their names in lower case. Text, datetimes, embedded objects and the paths of references
    /// are in double quotes, with `\` in front of each `"` and `\`; char16 is in single quotes, with `\` in front of `'` and `\`.
    /// Booleans are TRUE and FALSE, reals have the shortest text that reads back the same, null is NULL. One pass.
    ///
    /// Invariant: two keys of one type are equal by value if and only if their texts are equal, so the text identifies the
    /// instance. For that, what can be written in several ways is written in one: datetimes in UTC (TCIMDateTime::GetCanonical), -0
    /// as 0, namespaces and hosts in lower case, embedded objects as in TEmbeddedObject::GetKeyText, and references as their own
    /// path text. Names of classes and keys keep their spelling, which is the declared one if the class is known; of a class that
    /// nobody declared it is the written one, and its letter case counts. TCIMValue::IsSameKey is the same relation without the
    /// texts.
    ///
    /// Embedded objects and arrays are exceptions, because a path does not show all that equality by value compares. An embedded
    /// object and plain text that reads like its key text are different values with one text; so are arrays of such elements. The
    /// elements of a bag are sorted in the text: it is that of an array in the same order, and a bag may be equal to an array whose
    /// text is another one. The same holds for bags and arrays within embedded objects.
    std::string GetPath() const;
    /// The same text, appended to `out`.
    void AppendPath(std::string& out) const;
    /// The path for people: the same form, but namespace, host and key values as they were written. Equal paths may have different
    /// texts.
    std::string ToText() const;

    /// The namespace; null if there is none or it is gone.
    boost::shared_ptr<ICIMNamespace> GetNamespace() const;
    /// Empty if there is none.
    const std::string& GetNamespaceName() const;
    /// Slashes at both ends are removed. A name other than the present one, letter case aside, also removes the namespace.
    void SetNamespaceName(const std::string& name);
    /// Empty if there is none.
    const std::string& GetHost() const;
    void SetHost(const std::string& host);
    /// The class's name, also that of a stub; empty if there is no class.
    const std::string& GetClassName() const;
    /// Sets a stub class of that name, for a caller that does not have the class. An empty name removes the class.
    void SetClassName(const std::string& name);
    std::size_t GetKeyCount() const;
    /// The value bound to `name`, in any letter case, or null. Valid until the path changes.
    const TCIMValue* FindKeyValue(const std::string& name) const;

    /// Reads a path's text, with or without a leading slash or `//host/` (DSP0207) and with or without `namespace:`.
    ///
    /// In quotes any character may have a `\` in front. A number becomes uint64, sint64 (if it has a sign) or real64, text in
    /// double quotes a string. The path gets the class that `ns` declares, and each key of the class its declared spelling and
    /// type, if the value converts without loss. Its text is then that of the instance's own path, except that a reference among
    /// the keys keeps the namespace that it names, and an embedded object stays text; GetInstance finds the instance nevertheless.
    /// A reference nested too deeply for AddKeyValue stays text. If `ns` is null or does not declare the class, the path gets a
    /// stub. Errors: TZELException with kParseError (9) if the text is no path; `errorPosition`, if not null, then gets the byte
    /// offset. Also whatever GetClass of `ns` and GetPropertyDecl of the class throw, except kNotFound (15): a delta namespace, for
    /// example, throws kMissingParameter (38).
    static TCIMReference Parse(const std::string& text, boost::shared_ptr<ICIMNamespace> ns = boost::shared_ptr<ICIMNamespace>(),
                               std::size_t* errorPosition = nullptr);

  private:
    friend class TCIMValue;
    friend class TValueAccess;
    struct TContents;
    class TGrowingOut;

    explicit TCIMReference(TContents* contents) noexcept;
    TContents& Own();
    void AppendText(std::string& out, TCIMValue::EKeyForm form) const;
    template <class TOut>
    void WriteParts(TOut& out, const std::string& className) const;

    TContents* fContents;  // reference-counted; null means the empty path
};

}  // namespace NORVZEL20
