#include "cim/RegularFile.h"

#include <array>
#include <cerrno>
#include <system_error>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace cimhost::cim {

namespace {

[[noreturn]] void failWithErrno()
{
    throw FileError(std::generic_category().message(errno));
}

const char* fileType(mode_t mode)
{
    if (S_ISDIR(mode))
        return "a directory";
    return S_ISFIFO(mode) ? "a pipe" : "a device";
}

void checkType(int descriptor)
{
    struct stat status
    {};
    if (fstat(descriptor, &status) != 0)
        failWithErrno();
    if (!S_ISREG(status.st_mode))
        throw FileError(std::string("expected a regular file, found ") + fileType(status.st_mode));
}

} // namespace

// Without O_NONBLOCK opening a pipe would wait for somebody to write to it.
RegularFile::RegularFile(const std::string& name)
    : descriptor_(open(name.c_str(), O_RDONLY | O_CLOEXEC | O_NOCTTY | O_NONBLOCK))
{
    if (!descriptor_.isOpen())
        failWithErrno();
    checkType(descriptor_.number());
}

std::string RegularFile::read(std::size_t mostBytes) const
{
    std::string content;
    std::array<char, 65536> part{};
    while (true) {
        const ssize_t count = ::read(descriptor_.number(), part.data(), part.size());
        if (count < 0 && errno != EINTR)
            failWithErrno();
        if (count == 0)
            return content;
        if (count > 0)
            content.append(part.data(), static_cast<std::size_t>(count));
        if (content.size() > mostBytes)
            throw FileError("expected at most " + std::to_string(mostBytes) + " bytes, found more");
    }
}

} // namespace cimhost::cim
