// The entry that libFuzzer calls; CIMDELTA_FUZZ_FUNCTION is the target that this program was built for.
#include <cstddef>
#include <cstdint>

#include "fuzz/TFuzzTarget.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    NORVZEL20::CIMDELTA_FUZZ_FUNCTION(std::string_view(reinterpret_cast<const char*>(data), size));
    return 0;
}
