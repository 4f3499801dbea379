#pragma once

#include <cstddef>
#include <string>

#include "embedded/load/TTextPlace.h"

namespace NORVZEL20 {

/// How far a document has been read: what another parser needs to go on from there.
struct TXmlProgress {
    std::string tags;       ///< start tags of the open elements; `<a/>` if the outermost one has ended
    std::size_t depth = 0;  ///< open elements
    std::string text;       ///< since the last tag
    TTextPlace place;       ///< of the next byte
    bool isFirst = true;    ///< false if another document of a sequence is in front of it
};

}  // namespace NORVZEL20
