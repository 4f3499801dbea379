#include "client/comparison/AttributeToOptions.h"

#include <set>

#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

void AttributeToOptions(TCoverage& coverage, const std::vector<TInventory>& inventories, TRules& rules)
{
    for (TCoverage::TClass& cls : coverage.classes) {
        const boost::shared_ptr<TInMemClass> declared = inventories[0].ns->FindClass(cls.name);
        const std::vector<std::string> properties = declared ? rules.PropertiesOf(declared) : std::vector<std::string>();
        const std::set<std::string, TNameText::TLess> compared(properties.begin(), properties.end());
        const bool isOut = cls.state == TCoverage::kExcludedByRules || cls.state == TCoverage::kReachedByNoElement;
        if (isOut && !compared.empty()) {
            cls.state = TCoverage::kLeftOutByOptions;
        }
        for (TCoverage::TLeftOut& leftOut : cls.leftOut) {
            if (leftOut.reason == TCoverage::EReason::kLeftOutByRules && compared.count(leftOut.property) > 0) {
                leftOut.reason = TCoverage::EReason::kLeftOutByOptions;
            }
        }
    }
}

}  // namespace NORVZEL20
