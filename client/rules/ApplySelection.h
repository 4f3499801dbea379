#pragma once

#include "client/rules/TRulesDraft.h"
#include "client/rules/TSelection.h"

namespace NORVZEL20 {

/// Narrows the rules to what the selection names. A class stands for the classes below it too. An excluded key is left out of what
/// is compared as well.
///
/// Errors: TClientError that names the option if a name is none of the schema's, with the word that was probably meant, or if it
/// names only what the rules do not compare in any case.
void ApplySelection(const TSelection& selection, TRulesDraft& draft);

}  // namespace NORVZEL20
