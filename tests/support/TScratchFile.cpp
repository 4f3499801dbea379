#include "tests/support/TScratchFile.h"

#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <stdexcept>

namespace NORVZEL20 {

TScratchFile::TScratchFile(const std::string& contents)
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

TScratchFile::~TScratchFile()
{
    std::remove(fPath.c_str());
}

}  // namespace NORVZEL20
