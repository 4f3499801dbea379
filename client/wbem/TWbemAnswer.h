#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace NORVZEL20 {

/// What the message of an answer says beside its objects. A plain value.
struct TWbemAnswer {
    std::string operation;    ///< that it answers; empty if it names none
    std::string errorCode;    ///< the number of the CIM status as it was written; empty if the answer is no error
    std::string description;  ///< of the error
    std::size_t instances = 0;
    std::string context;             ///< of the enumeration that was opened or pulled
    bool isEndOfSequence = false;    ///< that enumeration has ended
    std::vector<std::string> names;  ///< the keys "Name" of the instance names in the answer
    bool isComplete = false;         ///< it was read to its end
};

}  // namespace NORVZEL20
