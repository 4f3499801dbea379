#include "client/process/WholeWrite.h"

#include <poll.h>
#include <unistd.h>

#include <cerrno>

namespace NORVZEL20 {

int WriteWhole(int descriptor, std::string_view text) noexcept
{
    while (!text.empty()) {
        const ssize_t written = write(descriptor, text.data(), text.size());
        if (written >= 0) {
            text.remove_prefix(static_cast<std::size_t>(written));
        } else if (errno == EAGAIN) {
            pollfd wait = {descriptor, POLLOUT, 0};
            poll(&wait, 1, -1);
        } else if (errno != EINTR) {
            return errno;
        }
    }
    return 0;
}

}  // namespace NORVZEL20
