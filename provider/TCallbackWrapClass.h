#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>

#include "host/Export.h"
#include "host/ICIMClass.h"
#include "host/ICIMNamespace.h"
#include "host/TUnaryFunction.h"

namespace NORVZEL20 {

/// Stands between an enumeration of classes and its callback: for each class, the callback gets the class of the same name in
/// another namespace instead.
///
/// The callback is not copied and must outlive the enumeration.
class CIMDELTA_INTERNAL_EXPORT TCallbackWrapClass : public TUnaryFunction<boost::shared_ptr<ICIMClass>> {
  public:
    TCallbackWrapClass(boost::shared_ptr<ICIMNamespace> ns, const boost::function<bool(boost::shared_ptr<ICIMClass>)>* callback,
                       const TCallContext& context);

    /// Calls the callback with the namespace's class of the same name as `cls`, and returns its result.
    /// Errors: those of the class and the namespace; boost::bad_function_call if the callback is empty.
    bool operator()(boost::shared_ptr<ICIMClass> cls) const;

  private:
    boost::shared_ptr<ICIMNamespace> fNamespace;
    const boost::function<bool(boost::shared_ptr<ICIMClass>)>* fCallback;
    TCallContext fContext;
};

}  // namespace NORVZEL20
