#include "embedded/cimxml/TXmlComment.h"

#include "embedded/cimxml/TXmlCharacter.h"
#include "embedded/cimxml/TXmlSearch.h"

namespace NORVZEL20 {

EXmlScan TXmlComment::Pass(const char*& at, const char* end) noexcept
{
    for (;;) {
        at = TXmlSearch::FindSpecial(at, '-');
        if (*at == '-' && at[1] == '-') {
            if (at + 2 >= end) {
                return EXmlScan::kCutOff;
            }
            at += 3;
            return at[-1] == '>' ? EXmlScan::kAccepted : EXmlScan::kRefused;
        }
        if (static_cast<unsigned char>(*at) >= 0x80U) {
            const EXmlScan scan = TXmlCharacter::Pass(at, end);
            if (scan != EXmlScan::kAccepted) {
                return scan;
            }
        } else if (static_cast<unsigned char>(*at) >= ' ' || TXmlCharacter::IsBlank(*at)) {
            ++at;
        } else {
            return at == end ? EXmlScan::kCutOff : EXmlScan::kRefused;
        }
    }
}

}  // namespace NORVZEL20
