#pragma once

#include <locale>
#include <sstream>

namespace NORVZEL20 {

/// A stream for the text of a message. Unlike a plain stream it throws std::bad_alloc if memory runs out, so a message is never
/// cut. Numbers are plain digits whatever the process's locale is.
class TMessageStream : public std::ostringstream {
  public:
    TMessageStream()
    {
        exceptions(std::ios_base::badbit);
        imbue(std::locale::classic());
    }
};

}  // namespace NORVZEL20
