#include "StandardErrorSink.h"

#include "Descriptor.h"
#include "LineWriter.h"

#include <climits>
#include <limits>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace MVLog {
namespace {

LineWriter writer; ///< of all sinks: they have one standard error

bool mayBlock()
{
    struct stat status
    {};
    return fstat(STDERR_FILENO, &status) == 0 && (S_ISFIFO(status.st_mode) || S_ISCHR(status.st_mode));
}

/// The pipe or terminal opened anew, as a descriptor that does not block: switching that for standard error itself
/// would switch it for all that write there. None where it cannot be opened: the pipe of another user.
Tavro::Descriptor withoutBlocking()
{
    return Tavro::Descriptor(::open("/proc/self/fd/2", O_WRONLY | O_NONBLOCK | O_CLOEXEC | O_NOCTTY));
}

} // namespace

void StandardErrorSink::sink_it_(const spdlog::details::log_msg& message)
{
    spdlog::memory_buf_t line;
    formatter_->format(message, line);
    const std::string_view text(line.data(), line.size());

    const bool blocks = mayBlock();
    const Tavro::Descriptor own = blocks ? withoutBlocking() : Tavro::Descriptor();
    const int error =
        own.isOpen()
            ? writer.write(own.number(), text)
            : writer.write(STDERR_FILENO, text, blocks ? PIPE_BUF : std::numeric_limits<std::size_t>::max());
    if (error != 0)
        throw spdlog::spdlog_ex("a log line is lost: cannot write to standard error", error);
}

} // namespace MVLog
