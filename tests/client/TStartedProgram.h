#pragma once

#include <sys/types.h>

#include <map>
#include <string>
#include <vector>

namespace NORVZEL20 {

/// The built program, running beside the test.
class TStartedProgram {
  public:
    /// Maps descriptors of the program to those of the test that it gets in their place; it inherits all others.
    using TDescriptors = std::map<int, int>;

    /// Starts the program. Ending signals have their default action in it, except `ignored`, which the test ignores by then.
    explicit TStartedProgram(const std::vector<std::string>& arguments, const TDescriptors& descriptors = TDescriptors(),
                             int ignored = 0);
    TStartedProgram(const TStartedProgram&) = delete;
    TStartedProgram& operator=(const TStartedProgram&) = delete;
    /// Kills the program if it still runs.
    ~TStartedProgram();

    /// Whether it has ended.
    bool HasEnded();
    /// Sends it a signal unless it has ended.
    void Signal(int number);
    /// Waits for its end. Returns how it ended: "status 2", "signal 15".
    std::string Wait();

  private:
    pid_t fProcess = 0;
    bool fEnded = false;
    int fStatus = 0;
};

}  // namespace NORVZEL20
