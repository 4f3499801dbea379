#pragma once

#include <boost/smart_ptr/enable_shared_from_this.hpp>
#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemQualifierDecl.h"
#include "embedded/store/TOwnPlace.h"
#include "embedded/value/ILocated.h"
#include "embedded/value/TNameText.h"
#include "host/Export.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// A namespace that holds classes, qualifier declarations and instances in memory.
///
/// It owns its classes and instances; handles that outlive it stay valid (see TInMemClass and TInMemInstance). To load many things,
/// all or none of them, use TInMemStaging. Assignment takes nothing over.
/// Threads: use a namespace, and everything in it, from one thread at a time; different namespaces may be used concurrently.
class CIMDELTA_EXPORT TInMemNamespace final : public ICIMNamespace,
                                              public ILocated,
                                              public boost::enable_shared_from_this<TInMemNamespace> {
  public:
    /// An empty namespace of that name; slashes in front and behind are taken off.
    static boost::shared_ptr<TInMemNamespace> Create(const std::string& name);
    TInMemNamespace(const TInMemNamespace&) = delete;
    ~TInMemNamespace() override;

    const std::string& GetNamespaceName() const override;

    boost::shared_ptr<INamespaceProvider> GetNamespaceProvider(TCallContext context) const override;
    void SetUpcallNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context) override;
    void AddUnderlyingNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context) override;
    /// `superClass` is null or "<root>" for a top-level class. Errors: kInvalidParameter (5) if it is not a class of this
    /// namespace, and for an empty name and the name "<root>".
    boost::shared_ptr<ICIMClass> AllocateClass(const std::string& name, boost::shared_ptr<ICIMClass> superClass,
                                               TCallContext context) override;
    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext context) override;
    void EnumerateRootClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback, TCallContext context) override;
    /// There are none.
    void EnumerateProviders(const boost::function<bool(boost::shared_ptr<IProvider>)>& callback, TCallContext context) override;
    boost::shared_ptr<ICIMQualifierDecl> AllocateQualifierDecl(const std::string& name, const TCIMValue& value,
                                                               ICIMQualifierDecl::EScope scope, ICIMQualifierDecl::EFlavor flavor,
                                                               TCallContext context) override;
    boost::shared_ptr<ICIMQualifierDecl> GetQualifierDecl(const std::string& name, TCallContext context) const override;
    void EnumerateQualifierDecls(const boost::function<bool(boost::shared_ptr<ICIMQualifierDecl>)>& callback,
                                 TCallContext context) const override;
    /// Throws kNotOffered (1): there are no indications.
    void Subscribe(boost::shared_ptr<ICIMIndicationFilter> filter,
                   const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, TCallContext context) override;
    /// The path's class and keys count, its namespace and host do not. Key values are converted to the declared types if nothing is
    /// lost by it. If no instance has these keys, references in them are also tried as a load stores them: without a namespace that
    /// is this one's own (GetOwnPlace), with names and keys as declared; and text that is an embedded object as that object, once a
    /// document was loaded. So a path read from text finds what it names. Errors: kNotFound (15), kTypeMismatch (13) if a key
    /// cannot be converted, kKeyMissing (14) if the path lacks one. A TStoreRefusal says which path and which key.
    boost::shared_ptr<ICIMInstance> GetInstance(const TCIMReference& path, TCallContext context) const override;
    /// Errors: those of GetInstance.
    void DeleteInstance(const TCIMReference& path, TCallContext context) override;
    /// Sets all `properties` or none. Errors: those of GetInstance; also kNotFound (15) if there is no such property, kTypeMismatch
    /// (13) if a value has another type, kInvalidParameter (5) if a key would change.
    void ModifyInstance(const TCIMReference& path, TCallContext properties, TCallContext context) override;
    /// Answers WQL, with the whole instances (see TQuery). Errors: TQueryError.
    void ExecuteQuery(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, std::string& language,
                      std::string& query, TCallContext context) override;
    /// Removes all instances; classes stay.
    void ClearInstances() override;
    ICIMNamespace& operator=(ICIMNamespace& other) override;
    TInMemNamespace& operator=(const TInMemNamespace& other) = delete;

    /// The class of that name, or null; null for "<root>" too.
    boost::shared_ptr<TInMemClass> FindClass(std::string_view name) const;
    /// As AllocateClass.
    boost::shared_ptr<TInMemClass> AllocateInMemClass(const std::string& name, boost::shared_ptr<TInMemClass> superClass);
    /// All classes in order of declaration, superclasses before their subclasses.
    const std::vector<boost::shared_ptr<TInMemClass>>& GetClasses() const noexcept { return fClasses; }
    /// Null if there is none.
    boost::shared_ptr<TInMemQualifierDecl> FindQualifierDecl(std::string_view name) const;
    const std::vector<boost::shared_ptr<TInMemQualifierDecl>>& GetQualifierDecls() const noexcept { return fQualifierDecls; }
    /// Errors: kAlreadyExists (12) if one of that name is declared.
    void AddQualifierDecl(boost::shared_ptr<TInMemQualifierDecl> decl);
    /// Takes out a declaration that AddQualifierDecl has added. Qualifiers made from it stay.
    void Withdraw(const TInMemQualifierDecl& decl) noexcept;
    /// The instance of that path; null if there is none or no such class. Errors: kTypeMismatch (13), kKeyMissing (14).
    boost::shared_ptr<TInMemInstance> FindInstance(const TCIMReference& path) const;
    /// What references may name and still stay in this namespace: what the last document that was loaded says of itself; before
    /// that, the name of the namespace with any host.
    const TOwnPlace& GetOwnPlace() const noexcept { return fOwnPlace; }
    void SetOwnPlace(TOwnPlace place) noexcept { fOwnPlace = std::move(place); }
    /// Reads the text of a key whose declaration says that it holds embedded objects. `depth` counts the objects around the key.
    /// Returns the text itself if it is no object.
    using TReadObject = TCIMValue (*)(const TCIMValue& text, const boost::shared_ptr<const TInMemNamespace>& ns, std::size_t depth);
    /// Without a reader, as before the first document is loaded, keys stay text: they are found by the canonical text alone.
    void SetObjectReader(TReadObject read) noexcept { fReadObject = read; }
    TCIMValue ReadObject(const TCIMValue& text, std::size_t depth) const;
    /// Call this after the text of a reference may have changed, with the spelling of a class or of a key: instances with
    /// references in their keys are then found by the new text. Cost: constant; the index of a class is made anew when it is next
    /// needed.
    void ReferenceTextsChanged() noexcept { ++fReferenceTextVersion; }

    /// TInMemClass::AddToNamespace and Validate. Errors: see there; nothing has changed then.
    void Declare(const boost::shared_ptr<TInMemClass>& cls);
    void CheckDeclarable(const TInMemClass& cls) const;
    /// Takes out a class that is declared here, with its instances. It must have no subclasses that are declared.
    void Withdraw(TInMemClass& cls) noexcept;
    /// The class above `cls`, "<root>" for a top-level class.
    TInMemClass& GetParent(const TInMemClass& cls) const noexcept;

  private:
    explicit TInMemNamespace(const std::string& name);

    struct TEntry {
        boost::shared_ptr<TInMemClass> cls;
        std::unique_ptr<TInMemExtent> extent;
    };

    boost::shared_ptr<TInMemInstance> RequireInstance(const TCIMReference& path) const;
    bool AdaptKeys(const TInMemLayout& layout, std::vector<TCIMValue>& keys) const;

    std::string fName;
    TOwnPlace fOwnPlace;
    TReadObject fReadObject = nullptr;
    boost::shared_ptr<TInMemClass> fRoot;  // "<root>": its subclasses are the top-level classes
    std::uint64_t fReferenceTextVersion = 0;
    std::vector<boost::shared_ptr<TInMemClass>> fClasses;
    TNameHashMap<TEntry> fClassesByName;
    std::vector<boost::shared_ptr<TInMemQualifierDecl>> fQualifierDecls;
    TNameHashMap<boost::shared_ptr<TInMemQualifierDecl>> fQualifierDeclsByName;
};

}  // namespace NORVZEL20
