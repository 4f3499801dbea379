#pragma once

#include <sys/types.h>

#include <map>
#include <string>
#include <vector>

namespace NORVZEL20 {

/// The built program, running beside the test.
class TStartedProgram {
  public:
    /// Which of its descriptors are which of the test's; the others are the test's own. Signals do to it what they do by
    /// themselves, except those that the test ignores by then and names in `ignored`.
    using TDescriptors = std::map<int, int>;

    explicit TStartedProgram(const std::vector<std::string>& arguments, const TDescriptors& descriptors = TDescriptors(),
                             int ignored = 0);
    TStartedProgram(const TStartedProgram&) = delete;
    TStartedProgram& operator=(const TStartedProgram&) = delete;
    /// Kills it where it still runs.
    ~TStartedProgram();

    /// Whether it has ended.
    bool HasEnded();
    /// Sends it a signal, unless it has ended.
    void Signal(int number);
    /// Waits for its end and tells it: "status 2", "signal 15".
    std::string Wait();

  private:
    pid_t fProcess = 0;
    bool fEnded = false;
    int fStatus = 0;
};

}  // namespace NORVZEL20
