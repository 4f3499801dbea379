#pragma once

#include <sstream>

namespace NORVZEL20 {

/// Puts together the text of a message. Throws where memory is short (std::bad_alloc), so that no text is cut without a word.
class TMessageStream : public std::ostringstream {
  public:
    TMessageStream() { exceptions(std::ios_base::badbit); }
};

}  // namespace NORVZEL20
