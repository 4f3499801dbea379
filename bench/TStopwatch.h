#pragma once

#include <chrono>
#include <ctime>

namespace NORVZEL20 {

/// Measures CPU time of the process and wall time since it was made.
class TStopwatch {
  public:
    double CpuMilliseconds() const { return Cpu() - fCpu; }
    double WallMilliseconds() const { return Wall() - fWall; }

  private:
    static double Cpu()
    {
        std::timespec time{};
        clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &time);
        return static_cast<double>(time.tv_sec) * 1e3 + static_cast<double>(time.tv_nsec) / 1e6;
    }
    static double Wall()
    {
        return std::chrono::duration<double, std::milli>(std::chrono::steady_clock::now().time_since_epoch()).count();
    }

    double fCpu = Cpu();
    double fWall = Wall();
};

}  // namespace NORVZEL20
