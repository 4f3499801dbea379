#include "embedded/cimxml/ReadObjectKey.h"

#include "embedded/cimxml/TCimXmlObjectReader.h"
#include "embedded/cimxml/TCimXmlPathReader.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/value/TValueAccess.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

TCIMValue ReadObjectKey(const TCIMValue& text, const boost::shared_ptr<const TInMemNamespace>& ns, std::size_t depth)
{
    // The load's own context must not see notes and errors of a text that may be none.
    TLoadContext context{depth};
    const TLoadContext::TAt somewhere(context, {});
    TCimXmlPathReader paths(context, ns);
    try {
        const TCIMValue object = TCimXmlObjectReader(context, ns, paths).Read(TValueAccess::GetText(text));
        return context.GetBadValues().HasAny() ? text : object;
    } catch (const TZELException& error) {
        if (error.GetStatusCode().GetStatus() == TZELStatusCode::kOutOfMemory) {
            throw;
        }
        return text;
    }
}

}  // namespace NORVZEL20
