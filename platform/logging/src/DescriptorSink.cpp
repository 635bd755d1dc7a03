#include "DescriptorSink.h"

#include <cerrno>
#include <cstddef>

#include <fcntl.h>
#include <unistd.h>

namespace MVLog {
namespace {

/// A pipe that nobody reads is refused instead of waited for.
int openToAppend(const std::string& file)
{
    const int descriptor =
        open(file.c_str(), O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC | O_NOCTTY | O_NONBLOCK, 0640);
    if (descriptor < 0)
        throw spdlog::spdlog_ex("cannot open " + file, errno);
    return descriptor;
}

} // namespace

DescriptorSink::DescriptorSink() : descriptor_(STDERR_FILENO), isOwned_(false) {}

DescriptorSink::DescriptorSink(const std::string& file) : descriptor_(openToAppend(file)), isOwned_(true) {}

DescriptorSink::~DescriptorSink()
{
    if (isOwned_)
        close(descriptor_);
}

void DescriptorSink::sink_it_(const spdlog::details::log_msg& message)
{
    spdlog::memory_buf_t line;
    formatter_->format(message, line);

    std::size_t done = 0;
    while (done < line.size()) {
        const ssize_t written = ::write(descriptor_, line.data() + done, line.size() - done);
        if (written >= 0)
            done += static_cast<std::size_t>(written);
        else if (errno != EINTR)
            throw spdlog::spdlog_ex("cannot write", errno);
    }
}

} // namespace MVLog
