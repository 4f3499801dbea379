#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "client/process/IConsole.h"
#include "client/rules/TRulesDocument.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// Says each warning of TRuleWarnings in a line of its own, as `name:line: warning: text`. Of very many, only the first ones, the
/// number of the others and `advice`. `schema` is the reference, for which the plug-in accepted `document`. Errors: those of the
/// schema.
void SayRuleWarnings(IConsole& console, const std::string& name, const TRulesDocument& document,
                     const boost::shared_ptr<ICIMNamespace>& schema, const std::string& advice);

}  // namespace NORVZEL20
