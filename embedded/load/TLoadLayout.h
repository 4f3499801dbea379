#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>
#include <vector>

#include "embedded/load/TLoadTarget.h"
#include "embedded/store/TInMemClass.h"
#include "embedded/value/TTextRun.h"

namespace NORVZEL20 {

/// What is looked up once for a class whose instances are read; it makes finding a property fast.
struct TLoadLayout {
    explicit TLoadLayout(boost::shared_ptr<TInMemClass> cls);
    TLoadLayout(const TLoadLayout&) = delete;
    TLoadLayout& operator=(const TLoadLayout&) = delete;

    boost::shared_ptr<TInMemClass> cls;
    std::vector<TLoadTarget> targets;  ///< by slot
    TLoadTarget* first = nullptr;      ///< in the order of declaration; null if the class has no properties
    bool isHeld = false;               ///< see TLateInstances::Hold
    std::uint32_t count = 0;           ///< of instances begun
    TTextRun::TPointer run;            ///< the last one with texts of these instances alone, or null; see TTextPool::FillRun
};

}  // namespace NORVZEL20
