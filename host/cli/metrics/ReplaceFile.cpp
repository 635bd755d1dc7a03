#include "cli/metrics/ReplaceFile.h"

#include "cim/Descriptor.h"
#include "cim/Utf8.h"
#include "cli/metrics/WriteAll.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <system_error>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace cimhost::cli {

namespace {

/// Read by everyone, as the process that collects such files is another's.
constexpr mode_t fileMode = 0644;

/// Makes a file beside the one of that name.
/// \param name  gets the new one's
/// \return whether the disk has all of it; if not, errno says why and there is no such file
bool makeBeside(std::string& name, std::string_view content)
{
    name += ".XXXXXX";
    const cim::Descriptor made(mkostemp(name.data(), O_CLOEXEC));
    if (!made.isOpen())
        return false;
    if (writeAll(made.number(), content) && fchmod(made.number(), fileMode) == 0 && fsync(made.number()) == 0)
        return true;
    const int reason = errno;
    unlink(name.c_str());
    errno = reason;
    return false;
}

bool takeThePlace(const std::string& made, const std::string& file)
{
    if (std::rename(made.c_str(), file.c_str()) == 0)
        return true;
    const int reason = errno;
    unlink(made.c_str());
    errno = reason;
    return false;
}

} // namespace

void replaceFile(const std::string& file, std::string_view content)
{
    std::string made = file;
    if (!makeBeside(made, content) || !takeThePlace(made, file))
        throw ReplaceError("cannot write " + cim::printable(file) + ": " +
                           std::generic_category().message(errno));
}

} // namespace cimhost::cli
