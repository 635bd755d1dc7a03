#include "cli/watch/CapturedErrors.h"

#include <array>
#include <sstream>

#include <fcntl.h>
#include <sys/mman.h>
#include <unistd.h>

namespace cimhost::cli {

// No pipe: a provider that fills it would wait for this thread, which waits for the provider.
CapturedErrors::CapturedErrors()
    : kept_(isatty(STDERR_FILENO) != 0 ? memfd_create("standard-error", MFD_CLOEXEC) : -1),
      before_(kept_.isOpen() ? fcntl(STDERR_FILENO, F_DUPFD_CLOEXEC, STDERR_FILENO + 1) : -1)
{
    if (before_.isOpen()) {
        fcntl(kept_.number(), F_SETFL, O_APPEND);
        dup2(kept_.number(), STDERR_FILENO);
    }
}

CapturedErrors::~CapturedErrors()
{
    if (!before_.isOpen())
        return;
    dup2(before_.number(), STDERR_FILENO);
    const std::string rest = read();
    // Where the terminal is gone there is nobody to tell.
    static_cast<void>(write(STDERR_FILENO, rest.data(), rest.size()) < 0);
}

std::vector<std::string> CapturedErrors::take()
{
    std::istringstream text(read());
    std::vector<std::string> lines;
    for (std::string line; std::getline(text, line);)
        lines.push_back(line);
    return lines;
}

std::string CapturedErrors::read()
{
    std::string text;
    std::array<char, 4096> part{};
    for (ssize_t count = 0; (count = pread(kept_.number(), part.data(), part.size(), taken_)) > 0;
         taken_ += count)
        text.append(part.data(), static_cast<std::size_t>(count));
    // Gives the memory back; what is written next goes behind all the same.
    fallocate(kept_.number(), FALLOC_FL_PUNCH_HOLE | FALLOC_FL_KEEP_SIZE, 0, taken_);
    return text;
}

} // namespace cimhost::cli
