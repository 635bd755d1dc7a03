#include "cli/watch/Terminal.h"

#include <array>
#include <cerrno>
#include <cstddef>
#include <string_view>
#include <system_error>

#include <sys/ioctl.h>
#include <unistd.h>

namespace cimhost::cli {

namespace {

// Control sequences of ECMA-48, as every terminal of today has them; 1049 and 25 are private modes that came
// with xterm.
constexpr const char* otherScreen = "\x1B[?1049h\x1B[?25l";
constexpr const char* formerScreen = "\x1B[?25h\x1B[?1049l";
constexpr const char* home = "\x1B[H";
constexpr const char* clearLine = "\x1B[K";
constexpr const char* clearBelow = "\x1B[J";

} // namespace

void writeNow(const std::string& text)
{
    std::size_t done = 0;
    while (done < text.size()) {
        const ssize_t written = write(STDOUT_FILENO, text.data() + done, text.size() - done);
        if (written >= 0)
            done += static_cast<std::size_t>(written);
        else if (errno != EINTR)
            throw std::system_error(errno, std::generic_category(), "cannot write to standard output");
    }
}

Terminal::Terminal()
{
    termios mode{};
    if (tcgetattr(STDIN_FILENO, &mode) == 0) {
        before_ = mode;
        mode.c_lflag &= ~static_cast<tcflag_t>(ECHO | ICANON);
        tcsetattr(STDIN_FILENO, TCSANOW, &mode);
    }
    writeNow(otherScreen);
}

Terminal::~Terminal()
{
    try {
        writeNow(formerScreen);
    } catch (const std::system_error&) {
        // A terminal that is gone needs no former screen.
    }
    if (before_)
        tcsetattr(STDIN_FILENO, TCSAFLUSH, &*before_); // what was typed meanwhile was meant for nobody
}

void Terminal::show(const std::vector<std::string>& lines) const
{
    std::string text = home;
    for (std::size_t i = 0; i < lines.size(); ++i)
        text += (i == 0 ? "" : "\r\n") + lines[i] + clearLine;
    writeNow(text + clearBelow);
}

int Terminal::keyboard() const
{
    return before_ ? STDIN_FILENO : -1;
}

bool Terminal::isEndAsked() const
{
    std::array<char, 64> keys{};
    const ssize_t count = ::read(keyboard(), keys.data(), keys.size());
    return count <= 0 ||
           std::string_view(keys.data(), static_cast<std::size_t>(count)).find('q') != std::string_view::npos;
}

TerminalSize Terminal::size()
{
    constexpr TerminalSize usual{80, 24};
    winsize found{};
    if (ioctl(STDOUT_FILENO, TIOCGWINSZ, &found) != 0 || found.ws_col == 0 || found.ws_row == 0)
        return usual;
    return {found.ws_col, found.ws_row};
}

} // namespace cimhost::cli
