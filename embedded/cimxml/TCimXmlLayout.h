#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <vector>

#include "embedded/cimxml/TCimXmlTarget.h"
#include "embedded/store/TInMemClass.h"

namespace NORVZEL20 {

/// What is looked up once for a class whose instances are read; it makes finding a property fast.
struct TCimXmlLayout {
    explicit TCimXmlLayout(boost::shared_ptr<TInMemClass> cls);
    TCimXmlLayout(const TCimXmlLayout&) = delete;
    TCimXmlLayout& operator=(const TCimXmlLayout&) = delete;

    boost::shared_ptr<TInMemClass> cls;
    std::vector<TCimXmlTarget> targets;  ///< by slot
    TCimXmlTarget* first = nullptr;      ///< in the order of declaration; null if the class has no properties
    bool isHeld = false;                 ///< see TCimXmlLateInstances::Hold
};

}  // namespace NORVZEL20
