#include "cli/metrics/WriteAll.h"

#include <cerrno>
#include <cstddef>

#include <unistd.h>

namespace cimhost::cli {

bool writeAll(int descriptor, std::string_view text)
{
    while (!text.empty()) {
        const ssize_t count = write(descriptor, text.data(), text.size());
        if (count < 0 && errno != EINTR)
            return false;
        text.remove_prefix(count > 0 ? static_cast<std::size_t>(count) : 0);
    }
    return true;
}

} // namespace cimhost::cli
