#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>

#include "host/Export.h"
#include "host/ICIMClass.h"
#include "host/ICIMNamespace.h"
#include "host/TUnaryFunction.h"

namespace NORVZEL20 {

/// Turns an enumeration of classes into one of the same-named classes of a namespace.
///
/// The callback is not copied and must outlive the enumeration.
class CIMDELTA_INTERNAL_EXPORT TCallbackWrapClass : public TUnaryFunction<boost::shared_ptr<ICIMClass>> {
  public:
    TCallbackWrapClass(boost::shared_ptr<ICIMNamespace> ns, const boost::function<bool(boost::shared_ptr<ICIMClass>)>* callback,
                       const TCallContext& context);

    /// Gets the namespace's class of the name of `cls` and returns what the callback says to it.
    /// Errors: those of class and namespace; boost::bad_function_call where the callback is empty.
    bool operator()(boost::shared_ptr<ICIMClass> cls) const;

  private:
    boost::shared_ptr<ICIMNamespace> fNamespace;
    const boost::function<bool(boost::shared_ptr<ICIMClass>)>* fCallback;
    TCallContext fContext;
};

}  // namespace NORVZEL20
