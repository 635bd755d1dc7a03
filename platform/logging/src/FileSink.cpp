#include "FileSink.h"

#include <cerrno>
#include <filesystem>
#include <system_error>
#include <utility>

#include <fcntl.h>
#include <sys/stat.h>

namespace MVLog {
namespace {

std::string absolute(const std::string& path)
{
    std::error_code error;
    const std::filesystem::path found = std::filesystem::absolute(path, error);
    return error ? path : found.string();
}

} // namespace

FileSink::FileSink(const std::string& path) : path_(absolute(path))
{
    if (const int error = open(); error != 0)
        throw spdlog::spdlog_ex("cannot open " + path, error);
}

int FileSink::open()
{
    // A pipe that nobody reads is refused instead of waited for. A symbolic link is not followed: in a folder where others
    // may write, it would turn the broker's lines into a file of their choice.
    Tavro::Descriptor file(::open(
        path_.c_str(), O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC | O_NOCTTY | O_NONBLOCK | O_NOFOLLOW, 0640));
    struct stat status
    {};
    if (!file.isOpen() || fstat(file.number(), &status) != 0)
        return errno;
    file_ = std::move(file);
    device_ = status.st_dev;
    inode_ = status.st_ino;
    writer_ = {};
    return 0;
}

bool FileSink::isMoved() const
{
    struct stat status
    {};
    return lstat(path_.c_str(), &status) != 0 || status.st_dev != device_ || status.st_ino != inode_;
}

void FileSink::sink_it_(const spdlog::details::log_msg& message)
{
    spdlog::memory_buf_t line;
    formatter_->format(message, line);

    const int error = isMoved() ? open() : 0;
    if (const int lost = writer_.write(file_.number(), {line.data(), line.size()}); lost != 0)
        throw spdlog::spdlog_ex("a log line is lost: cannot write to " + path_, lost);
    if (error != 0)
        throw spdlog::spdlog_ex("log lines go on into the file that was moved away: cannot open " + path_,
                                error);
}

} // namespace MVLog
