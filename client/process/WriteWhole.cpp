#include "client/process/WriteWhole.h"

#include <poll.h>
#include <unistd.h>

#include "client/process/SystemError.h"

namespace NORVZEL20 {

void WriteWhole(int descriptor, std::string_view text)
{
    const std::error_code error = TryWriteWhole(descriptor, text);
    if (error) {
        throw std::system_error(error);
    }
}

std::error_code TryWriteWhole(int descriptor, std::string_view text) noexcept
{
    while (!text.empty()) {
        const ssize_t written = write(descriptor, text.data(), text.size());
        if (written >= 0) {
            text.remove_prefix(static_cast<std::size_t>(written));
            continue;
        }
        const std::error_code reason = LastSystemError();
        if (reason == std::errc::resource_unavailable_try_again) {
            // Whoever started the program may have made the descriptor non-blocking.
            pollfd wait = {descriptor, POLLOUT, 0};
            poll(&wait, 1, -1);
        } else if (reason != std::errc::interrupted) {
            return reason;
        }
    }
    return {};
}

}  // namespace NORVZEL20
