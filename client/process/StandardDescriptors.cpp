#include "client/process/StandardDescriptors.h"

#include <fcntl.h>
#include <unistd.h>

#include <initializer_list>

namespace NORVZEL20 {

void ReserveStandardDescriptors() noexcept
{
    for (const int descriptor : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO}) {
        if (fcntl(descriptor, F_GETFD) < 0) {
            // open() returns the lowest free number, which is this one. O_PATH makes a descriptor that can be neither read nor
            // written. Unlike /dev/null, the root folder exists everywhere.
            open("/", O_PATH);
        }
    }
}

bool IsClosed(int descriptor) noexcept
{
    const int flags = fcntl(descriptor, F_GETFL);
    return flags < 0 || (flags & O_PATH) != 0;
}

}  // namespace NORVZEL20
