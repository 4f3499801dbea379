#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <vector>

#include "embedded/cimxml/TCimXmlItem.h"
#include "embedded/store/TInMemClass.h"

namespace NORVZEL20 {

/// What is looked up once for a class whose instances are read; it makes finding a property fast. The vectors are indexed by slot.
struct TCimXmlLayout {
    /// What a start tag of a property means in instances of the class.
    struct TTag {
        std::size_t number = std::numeric_limits<std::size_t>::max();  ///< see IXmlSink::OnKnownStart; at first, that of no tag
        TCIMValue::TCIMType type = TCIMValue::TCIMType::kNone;
        TCimXmlItem::EText text = TCimXmlItem::kPlain;
    };

    explicit TCimXmlLayout(boost::shared_ptr<TInMemClass> cls);

    boost::shared_ptr<TInMemClass> cls;
    std::vector<bool> embedded;            ///< see TCimXmlTarget
    std::vector<std::uint32_t> positions;  ///< in the order of declaration
    std::vector<std::uint32_t> given;      ///< the number of the last instance that had the property
    std::vector<TTag> tags;                ///< the last one of the property
    bool isHeld = false;                   ///< see TCimXmlLateInstances::Hold
};

}  // namespace NORVZEL20
