#pragma once

#include <sstream>

namespace NORVZEL20 {

/// A stream for the text of a message. Unlike a plain stream it throws std::bad_alloc if memory runs out, so a message is never
/// cut.
class TMessageStream : public std::ostringstream {
  public:
    TMessageStream() { exceptions(std::ios_base::badbit); }
};

}  // namespace NORVZEL20
