#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string_view>
#include <vector>

#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

/// The declaration of that name in a short list, or null. Letter case does not count. Cost: in proportion to the list.
template <class TDecl>
boost::shared_ptr<TDecl> FindNamed(const std::vector<boost::shared_ptr<TDecl>>& decls, std::string_view name)
{
    for (const boost::shared_ptr<TDecl>& decl : decls) {
        if (TNameText::Equal(decl->GetName(), name)) {
            return decl;
        }
    }
    return nullptr;
}

}  // namespace NORVZEL20
