#include "ReadFile.h"

#include "Descriptor.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <system_error>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace Tavro {
namespace {

constexpr std::size_t roomBehind = 64; ///< for whoever ends the content as a parser wants it

[[noreturn]] void failWithErrno()
{
    const int reason = errno;
    const std::string text = "expected a readable file: " + std::generic_category().message(reason);
    if (reason == ENOENT || reason == ENOTDIR)
        throw FileMissing(text);
    throw ReadFailure(text);
}

std::string fileType(mode_t mode)
{
    if (S_ISDIR(mode))
        return "a directory";
    if (S_ISFIFO(mode))
        return "a pipe";
    return "a device";
}

/// \return how long the file is now
std::size_t checkType(int descriptor)
{
    struct stat status
    {};
    if (fstat(descriptor, &status) != 0)
        failWithErrno();
    if (!S_ISREG(status.st_mode))
        throw ReadFailure("expected a regular file, found " + fileType(status.st_mode));
    return static_cast<std::size_t>(status.st_size);
}

/// Appends what one call reads. \return whether there was anything left to read
bool readPart(int descriptor, std::string& content)
{
    std::array<char, 65536> part;
    ssize_t count = 0;
    do
        count = read(descriptor, part.data(), part.size());
    while (count < 0 && errno == EINTR);
    if (count < 0)
        failWithErrno();
    content.append(part.data(), static_cast<std::size_t>(count));
    return count > 0;
}

} // namespace

std::string readFile(const std::string& name, std::size_t mostBytes)
{
    // Without O_NONBLOCK opening a pipe would wait for somebody to write to it.
    const Descriptor file(open(name.c_str(), O_RDONLY | O_CLOEXEC | O_NOCTTY | O_NONBLOCK));
    if (!file.isOpen())
        failWithErrno();
    const std::size_t size = checkType(file.number());

    std::string content;
    content.reserve(std::min(size, mostBytes) + roomBehind);
    while (readPart(file.number(), content))
        if (content.size() > mostBytes)
            throw ReadFailure("expected at most " + std::to_string(mostBytes) + " bytes, found more");
    return content;
}

} // namespace Tavro
