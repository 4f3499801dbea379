// The function that libFuzzer calls for each input. The build defines CIMDELTA_FUZZ_FUNCTION as the target of this program.
#include <cstddef>
#include <cstdint>

#include "fuzz/TFuzzTarget.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    NORVZEL20::CIMDELTA_FUZZ_FUNCTION(std::string_view(reinterpret_cast<const char*>(data), size));
    return 0;
}
