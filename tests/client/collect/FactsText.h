#pragma once

#include <string>
#include <vector>

#include "client/collect/read/TFacts.h"
#include "client/collect/read/TReadFaults.h"

namespace NORVZEL20 {

/// Facts as lines: "Disk: DeviceID=sda Size=5". KALMO_ is left out.
inline std::string FactsText(const std::vector<TFacts>& all)
{
    std::string text;
    for (const TFacts& facts : all) {
        text += std::string(facts.GetClassName()).substr(6) + ":";
        for (const TFacts::TValue& value : facts.GetValues()) {
            text += std::string(" ") + value.first + "=" + value.second.ToText();
        }
        text += "\n";
    }
    return text;
}

/// The same of what a reader makes of a text, with a line about what it could not take.
template <class TReader>
std::string ReadText(TReader reader, const std::string& text)
{
    TReadFaults faults;
    const std::string facts = FactsText(reader(text, faults));
    return faults.GetCount() == 0 ? facts : facts + std::to_string(faults.GetCount()) + " bad: " + faults.GetFirst() + "\n";
}

}  // namespace NORVZEL20
