#include "provider/TCallbackWrapClass.h"

#include <utility>

namespace NORVZEL20 {

TCallbackWrapClass::TCallbackWrapClass(boost::shared_ptr<ICIMNamespace> ns,
                                       const boost::function<bool(boost::shared_ptr<ICIMClass>)>* callback,
                                       const TCallContext& context)
    : fNamespace(std::move(ns)), fCallback(callback), fContext(context)
{}

bool TCallbackWrapClass::operator()(boost::shared_ptr<ICIMClass> cls) const
{
    // The namespace makes the wrapper, or returns the one that it has.
    return (*fCallback)(fNamespace->GetClass(cls->GetName(fContext), fContext));
}

}  // namespace NORVZEL20
