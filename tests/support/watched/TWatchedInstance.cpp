#include "tests/support/watched/TWatchedInstance.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "tests/support/CallText.h"
#include "tests/support/watched/TWatchedClass.h"
#include "tests/support/watched/TWatchedProperty.h"

namespace NORVZEL20 {

TWatchedInstance::TWatchedInstance(boost::shared_ptr<ICIMInstance> instance, boost::shared_ptr<TCallWatch> watch,
                                   const std::string& label, const std::string& namespaceLabel)
    : fInstance(instance), fWatch(watch), fLabel(label), fNamespaceLabel(namespaceLabel)
{}

void TWatchedInstance::Validate(TCallContext context) const
{
    fWatch->Called(fLabel + ".Validate()" + ContextText(context));
    fInstance->Validate(context);
}

void TWatchedInstance::AddToNamespace(TCallContext context)
{
    fWatch->Called(fLabel + ".AddToNamespace()" + ContextText(context));
    fInstance->AddToNamespace(context);
}

TCIMReference TWatchedInstance::GetReference(TCallContext context) const
{
    fWatch->Called(fLabel + ".GetReference()" + ContextText(context));
    return fInstance->GetReference(context);
}

boost::shared_ptr<ICIMClass> TWatchedInstance::GetClass(TCallContext context) const
{
    fWatch->Called(fLabel + ".GetClass()" + ContextText(context));
    return boost::make_shared<TWatchedClass>(fInstance->GetClass(context), fWatch, fNamespaceLabel);
}

boost::shared_ptr<ICIMProperty> TWatchedInstance::GetProperty(const std::string& name, TCallContext context) const
{
    fWatch->Called(fLabel + ".GetProperty(" + Quoted(name) + ")" + ContextText(context));
    return boost::make_shared<TWatchedProperty>(fInstance->GetProperty(name, context), fWatch, fLabel);
}

void TWatchedInstance::EnumerateProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                                           TCallContext context) const
{
    fWatch->Called(fLabel + ".EnumerateProperties()" + ContextText(context));
    const auto passOn = [&](boost::shared_ptr<ICIMProperty> property) {
        return callback(boost::make_shared<TWatchedProperty>(property, fWatch, fLabel));
    };
    fInstance->EnumerateProperties(passOn, context);
}

}  // namespace NORVZEL20
