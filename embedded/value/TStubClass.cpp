#include "embedded/value/TStubClass.h"

#include "embedded/value/TNameText.h"
#include "host/ICIMNamespace.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

/// Ends every operation that would change the class.
[[noreturn]] void Refuse()
{
    throw TZELException(TZELStatusCode::kNotSupported);
}

/// Ends every look-up of something that a stub does not have.
[[noreturn]] void Miss()
{
    throw TZELException(TZELStatusCode::kNotFound);
}

}  // namespace

TStubClass::TStubClass(std::string name) : fName(std::move(name)) {}

void TStubClass::Validate(TCallContext) const
{
    Refuse();
}

void TStubClass::AddToNamespace(TCallContext)
{
    Refuse();
}

void TStubClass::RemoveFromNamespace(TCallContext)
{
    Refuse();
}

void TStubClass::ModifyClass(boost::shared_ptr<ICIMClass>, TCallContext)
{
    Refuse();
}

const std::string& TStubClass::GetName(TCallContext) const
{
    return fName;
}

boost::shared_ptr<ICIMNamespace> TStubClass::GetNamespace(TCallContext) const
{
    return nullptr;
}

bool TStubClass::IsAssociation(TCallContext) const
{
    return false;
}

bool TStubClass::IsAbstract(TCallContext) const
{
    return false;
}

bool TStubClass::IsRootClass(TCallContext) const
{
    return true;
}

boost::shared_ptr<ICIMClass> TStubClass::GetSuperClass(TCallContext) const
{
    return nullptr;
}

void TStubClass::EnumerateSubClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>&, bool, TCallContext) {}

bool TStubClass::IsSubclassOf(boost::shared_ptr<const ICIMClass> cls, TCallContext) const
{
    return TNameText::Equal(fName, cls->GetName(TCallContext()));
}

void TStubClass::EnumerateAssociatedClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>&, const std::string&,
                                            const std::string&, const std::string&, const std::string&, TCallContext)
{}

void TStubClass::EnumerateAssociationClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>&, const std::string&,
                                             const std::string&, TCallContext)
{}

void TStubClass::EnumerateKeyNames(const boost::function<bool(const std::string*)>&, TCallContext) const {}

boost::shared_ptr<ICIMPropertyDecl> TStubClass::AllocatePropertyDecl(const std::string&, const TCIMValue&, TCallContext)
{
    Refuse();
}

boost::shared_ptr<ICIMPropertyDecl> TStubClass::GetPropertyDecl(const std::string&, TCallContext) const
{
    Miss();
}

void TStubClass::EnumeratePropertyDecls(const boost::function<bool(boost::shared_ptr<ICIMPropertyDecl>)>&, TCallContext) const {}

boost::shared_ptr<ICIMProperty> TStubClass::GetProperty(const std::string&, TCallContext)
{
    Miss();
}

void TStubClass::SetPropertyValue(const std::string&, const TCIMValue&, TCallContext)
{
    Miss();
}

void TStubClass::EnumerateStaticProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>&, TCallContext) {}

boost::shared_ptr<ICIMInstance> TStubClass::AllocateInstance(TCallContext)
{
    Refuse();
}

void TStubClass::EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>&, bool, TCallContext) {}

boost::shared_ptr<ICIMMethodDecl> TStubClass::AllocateMethodDecl(const std::string&, TCIMValue::TCIMType, TCallContext)
{
    Refuse();
}

boost::shared_ptr<ICIMMethodDecl> TStubClass::GetMethodDecl(const std::string&, TCallContext) const
{
    Miss();
}

void TStubClass::EnumerateMethodDecls(const boost::function<bool(boost::shared_ptr<ICIMMethodDecl>)>&, TCallContext) const {}

TCIMValue TStubClass::InvokeMethod(const std::string&, TCallContext&, TCallContext)
{
    Miss();
}

bool TStubClass::operator==(ICIMClass& other) const
{
    return TNameText::Equal(fName, other.GetName(TCallContext()));
}

bool TStubClass::operator<(ICIMClass& other) const
{
    return TNameText::Compare(fName, other.GetName(TCallContext())) < 0;
}

ICIMClass& TStubClass::operator=(const ICIMClass&)
{
    Refuse();
}

bool TStubClass::AddChildClass(boost::shared_ptr<ICIMClass>)
{
    Refuse();
}

bool TStubClass::RemoveChildClass(boost::shared_ptr<ICIMClass>)
{
    Refuse();
}

bool TStubClass::AddInstance(boost::shared_ptr<ICIMInstance>)
{
    Refuse();
}

bool TStubClass::RemoveInstance(boost::shared_ptr<ICIMInstance>)
{
    Refuse();
}

bool TStubClass::AddAssociationClass(boost::shared_ptr<ICIMClass>)
{
    Refuse();
}

bool TStubClass::RemoveAssociationClass(boost::shared_ptr<ICIMClass>)
{
    Refuse();
}

bool TStubClass::AddPropertyDecl(boost::shared_ptr<ICIMPropertyDecl>)
{
    Refuse();
}

bool TStubClass::RemovePropertyDecl(boost::shared_ptr<ICIMPropertyDecl>)
{
    Refuse();
}

bool TStubClass::AddMethodDecl(boost::shared_ptr<ICIMMethodDecl>)
{
    Refuse();
}

bool TStubClass::RemoveMethodDecl(boost::shared_ptr<ICIMMethodDecl>)
{
    Refuse();
}

void TStubClass::AddQualifier(boost::shared_ptr<ICIMQualifier>, TCallContext)
{
    Refuse();
}

boost::shared_ptr<ICIMQualifier> TStubClass::AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl>, const TCIMValue&,
                                                               TCallContext) const
{
    Refuse();
}

boost::shared_ptr<ICIMQualifier> TStubClass::AllocateQualifier(boost::shared_ptr<const ICIMQualifierDecl>, const TCIMValue&,
                                                               ICIMQualifierDecl::EFlavor, TCallContext) const
{
    Refuse();
}

boost::shared_ptr<ICIMQualifier> TStubClass::GetQualifier(const std::string&, TCallContext) const
{
    Miss();
}

boost::shared_ptr<ICIMQualifier> TStubClass::GetQualifier(const std::string&, bool& found, TCallContext) const
{
    found = false;
    return nullptr;
}

void TStubClass::EnumerateQualifiers(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>&, TCallContext) const {}

}  // namespace NORVZEL20
