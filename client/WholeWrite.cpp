#include "client/WholeWrite.h"

#include <unistd.h>

#include <cerrno>

namespace NORVZEL20 {

int WriteWhole(int descriptor, const std::string& text) noexcept
{
    std::size_t done = 0;
    while (done < text.size()) {
        const ssize_t written = write(descriptor, text.data() + done, text.size() - done);
        if (written >= 0) {
            done += static_cast<std::size_t>(written);
        } else if (errno != EINTR) {
            return errno;
        }
    }
    return 0;
}

}  // namespace NORVZEL20
