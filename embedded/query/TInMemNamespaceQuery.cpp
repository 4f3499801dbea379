// The one operation of an in-memory namespace that needs the query language. It is defined here because the store must not depend
// on the query language.

#include "embedded/query/TQuery.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

void TInMemNamespace::ExecuteQuery(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, std::string& language,
                                   std::string& query, TCallContext)
{
    TQuery(language, query).Execute(*this, callback);
}

}  // namespace NORVZEL20
