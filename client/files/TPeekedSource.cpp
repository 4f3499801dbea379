#include "client/files/TPeekedSource.h"

namespace NORVZEL20 {

TPeekedSource::TPeekedSource(IByteSource& source, std::size_t count) : fSource(source), fBeginning(count, '\0')
{
    std::size_t length = 0;
    while (length < count) {
        const std::size_t piece = source.Read(&fBeginning[length], count - length);
        if (piece == 0) {
            break;
        }
        length += piece;
    }
    fBeginning.resize(length);
}

std::size_t TPeekedSource::Read(char* buffer, std::size_t size)
{
    if (fDelivered == fBeginning.size()) {
        return fSource.Read(buffer, size);
    }
    const std::size_t count = fBeginning.copy(buffer, size, fDelivered);
    fDelivered += count;
    return count;
}

}  // namespace NORVZEL20
