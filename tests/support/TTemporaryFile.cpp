#include "tests/support/TTemporaryFile.h"

#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <stdexcept>

namespace NORVZEL20 {

TTemporaryFile::TTemporaryFile(const std::string& contents)
{
    const char* folder = std::getenv("TMPDIR");
    fPath = std::string(folder ? folder : "/tmp") + "/cimdelta-test-XXXXXX";
    const int descriptor = mkstemp(fPath.data());
    if (descriptor == -1) {
        throw std::runtime_error("no temporary file in " + fPath);
    }
    close(descriptor);
    std::ofstream(fPath, std::ios::binary) << contents;
}

TTemporaryFile::~TTemporaryFile()
{
    std::remove(fPath.c_str());
}

}  // namespace NORVZEL20
