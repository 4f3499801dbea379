#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>
#include <vector>

#include "embedded/store/TInMemClass.h"

namespace NORVZEL20 {

/// What is looked up once for a class whose instances are read; it makes finding a property fast. The vectors are indexed by slot.
struct TCimXmlLayout {
    explicit TCimXmlLayout(boost::shared_ptr<TInMemClass> cls);

    boost::shared_ptr<TInMemClass> cls;
    std::vector<bool> embedded;            ///< see TCimXmlTarget
    std::vector<std::uint32_t> positions;  ///< in the order of declaration
    std::vector<std::uint32_t> given;      ///< the number of the last instance that had the property
    bool isHeld = false;                   ///< see TCimXmlLateInstances::Hold
};

}  // namespace NORVZEL20
