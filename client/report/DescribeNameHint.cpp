#include "client/report/DescribeNameHint.h"

#include "client/text/Counted.h"
#include "client/text/DisplayText.h"
#include "client/text/QuoteForShell.h"

namespace NORVZEL20 {

std::string DescribeNameHint(const TNameHint& hint)
{
    return "Hint: 0 of " + Counted(hint.instances.front(), "instance") + " of " + EscapeForDisplay(hint.className) + " match; " +
           EscapeForDisplay(hint.property) + " has one value in each inventory: try --self " +
           EscapeForDisplay(QuoteForShell(hint.property)) + ".";
}

}  // namespace NORVZEL20
