#pragma once

#include <sys/wait.h>

#include <array>
#include <cstdio>
#include <string>

#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {

/// Runs the built program itself, through a shell.
class TProgramFixture : public TClientFixture {
  protected:
    /// Returns "[STATUS]", a line end, standard output, "--", a line end and standard error. `before` is put before the command.
    std::string Shell(const std::string& arguments, const std::string& before = std::string())
    {
        const std::string err = Scratch("stderr", "");
        const std::string command = before + CIMDELTA_PROGRAM + " " + arguments + " 2>" + err;
        std::FILE* pipe = popen(command.c_str(), "r");
        std::string out;
        std::array<char, 4096> buffer;
        while (const std::size_t count = std::fread(buffer.data(), 1, buffer.size(), pipe)) {
            out.append(buffer.data(), count);
        }
        const int status = pclose(pipe);
        return "[" + std::to_string(WEXITSTATUS(status)) + "]\n" + out + "--\n" + ReadFile(err);
    }
};

}  // namespace NORVZEL20
