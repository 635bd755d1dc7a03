#include "SysfsDirectory.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <climits>
#include <memory>
#include <string_view>

#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>

namespace Tavro {
namespace {

/// A name that is not there, or a device that has gone since its directory or attribute was opened.
bool isAbsence(int errorCode)
{
    return errorCode == ENOENT || errorCode == ENODEV || errorCode == ENXIO;
}

/// Appends up to that many bytes from where the text ends in the file. Nothing that is no file has such a place: of a pipe
/// nothing is read. \return how many; negative: errno says why not
ssize_t readPart(const Descriptor& file, std::size_t mostBytes, std::string& text)
{
    std::array<char, SysfsDirectory::pageSize> part;
    ssize_t count = 0;
    do
        count = pread(file.number(), part.data(), std::min(part.size(), mostBytes),
                      static_cast<off_t>(text.size()));
    while (count < 0 && errno == EINTR);
    if (count > 0)
        text.append(part.data(), static_cast<std::size_t>(count));
    return count;
}

} // namespace

bool SysfsAttribute::isAbsent() const
{
    return isAbsence(errorCode);
}

SysfsDirectory::SysfsDirectory(int base, const std::string& path)
    // A path only: it is enough to look things up, costs least, and touches no driver.
    : descriptor_(openat(base, path.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC)),
      errorCode_(descriptor_.isOpen() ? 0 : errno)
{}

SysfsDirectory::SysfsDirectory(const std::string& path) : SysfsDirectory(AT_FDCWD, path) {}

SysfsDirectory::SysfsDirectory(const SysfsDirectory& parent, const std::string& path)
    : SysfsDirectory(parent.descriptor_.number(), path)
{}

bool SysfsDirectory::isAbsent() const
{
    return isAbsence(errorCode_);
}

std::vector<std::string> SysfsDirectory::names() const
{
    return entries([](const dirent& /*entry*/) { return true; });
}

std::vector<std::string> SysfsDirectory::directories() const
{
    return entries([this](const dirent& entry) {
        return entry.d_type == DT_UNKNOWN ? hasDirectory(entry.d_name) : entry.d_type == DT_DIR;
    });
}

template <class IsWanted>
std::vector<std::string> SysfsDirectory::entries(IsWanted isWanted) const
{
    Descriptor listed(openat(descriptor_.number(), ".", O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    const auto closeStream = [](DIR* stream) { closedir(stream); };
    const std::unique_ptr<DIR, decltype(closeStream)> stream(fdopendir(listed.number()), closeStream);
    if (!stream)
        return {};
    (void)listed.release(); // the stream's
    std::vector<std::string> names;
    while (const dirent* const entry = readdir(stream.get())) // of a stream that no other thread has
        if (const std::string_view name = entry->d_name; name != "." && name != ".." && isWanted(*entry))
            names.emplace_back(name);
    std::sort(names.begin(), names.end());
    return names;
}

bool SysfsDirectory::hasDirectory(const char* name) const
{
    struct stat status
    {};
    return fstatat(descriptor_.number(), name, &status, AT_SYMLINK_NOFOLLOW) == 0 && S_ISDIR(status.st_mode);
}

std::optional<std::string> SysfsDirectory::linkTarget(const std::string& name) const
{
    std::array<char, PATH_MAX> target;
    const ssize_t length = readlinkat(descriptor_.number(), name.c_str(), target.data(), target.size());
    if (length < 0)
        return std::nullopt;
    return std::string(target.data(), static_cast<std::size_t>(length));
}

bool SysfsDirectory::leadsTo(const SysfsDirectory& directory, const std::string& name) const
{
    struct stat there
    {};
    struct stat opened
    {};
    return fstatat(descriptor_.number(), name.c_str(), &there, 0) == 0 &&
           fstat(directory.descriptor_.number(), &opened) == 0 && there.st_dev == opened.st_dev &&
           there.st_ino == opened.st_ino;
}

SysfsAttribute SysfsDirectory::attribute(const std::string& name, std::size_t mostBytes) const
{
    // Without O_NONBLOCK opening a pipe would wait for somebody to write to it. Attributes are no links.
    const Descriptor file(openat(descriptor_.number(), name.c_str(),
                                 O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY | O_CLOEXEC));
    SysfsAttribute attribute;
    if (!file.isOpen()) {
        attribute.errorCode = errno;
        return attribute;
    }
    ssize_t count = 0;
    do
        count = readPart(file, mostBytes - attribute.text.size(), attribute.text);
    // Less than a page is the end: sysfs hands out no less while there is more.
    while (count == static_cast<ssize_t>(pageSize) && attribute.text.size() < mostBytes);
    if (count < 0)
        attribute.errorCode = errno;
    return attribute;
}

} // namespace Tavro
