// A signal that ends the process while a password is typed must not leave the terminal without echo. So its settings from before
// are kept in static storage, written before gHiddenOn says so, and the signal handler puts them back.
#include "client/process/AskOnTerminal.h"

#include <fcntl.h>
#include <termios.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>

#include "client/process/TDescriptor.h"
#include "client/process/WriteWhole.h"

namespace NORVZEL20 {

namespace {

const std::size_t kLongestLine = 4096;

termios gSettingsBefore;
std::atomic<int> gHiddenOn{-1};  // the terminal's descriptor; -1 if typing shows
static_assert(std::atomic<int>::is_always_lock_free, "a signal handler reads it");

// The terminal, closed at the end.
class TTerminal {
  public:
    TTerminal() noexcept : fOpen(open("/dev/tty", O_RDWR | O_CLOEXEC | O_NOCTTY)) {}
    TTerminal(const TTerminal&) = delete;
    TTerminal& operator=(const TTerminal&) = delete;
    ~TTerminal() { ShowTypingAgain(); }

    int Get() const noexcept { return fOpen.Get(); }

    // Returns whether typing is hidden now.
    bool Hide() noexcept
    {
        if (tcgetattr(Get(), &gSettingsBefore) != 0) {
            return false;
        }
        gHiddenOn = Get();
        termios settings = gSettingsBefore;
        settings.c_lflag &= ~static_cast<tcflag_t>(ECHO);
        return tcsetattr(Get(), TCSAFLUSH, &settings) == 0;
    }

    // A line without its end; nothing if the terminal is closed first.
    std::optional<std::string> ReadLine()
    {
        std::string line;
        for (char c = 0; line.size() < kLongestLine;) {
            const ssize_t count = read(Get(), &c, 1);
            if (count == 1 && c == '\n') {
                return line;
            }
            if (count == 1) {
                line += c;
            } else if (count == 0 || errno != EINTR) {
                break;
            }
        }
        return std::nullopt;
    }

  private:
    const TDescriptor fOpen;
};

}  // namespace

bool HasTerminal() noexcept
{
    return TTerminal().Get() >= 0;
}

std::optional<std::string> AskOnTerminal(const std::string& question, bool isHidden)
{
    TTerminal terminal;
    if (terminal.Get() < 0 || (isHidden && !terminal.Hide())) {
        return std::nullopt;
    }
    TryWriteWhole(terminal.Get(), question);
    const std::optional<std::string> line = terminal.ReadLine();
    if (isHidden) {
        TryWriteWhole(terminal.Get(), "\n");
    }
    return line;
}

void ShowTypingAgain() noexcept
{
    const int descriptor = gHiddenOn.exchange(-1);
    if (descriptor >= 0) {
        tcsetattr(descriptor, TCSANOW, &gSettingsBefore);
    }
}

}  // namespace NORVZEL20
