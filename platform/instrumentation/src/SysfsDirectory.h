/// \file
/// Reading sysfs: directories of attributes, any of which may vanish at any time.
#ifndef TAVRO_SYSFSDIRECTORY_H
#define TAVRO_SYSFSDIRECTORY_H

#include "Descriptor.h"

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace Tavro {

/// What came of reading an attribute.
struct SysfsAttribute
{
    std::string text;  ///< its content, cut at the bound
    int errorCode = 0; ///< an errno value; 0: it was read

    [[nodiscard]] bool isRead() const { return errorCode == 0; }
    /// There is none of that name, or its device has gone.
    [[nodiscard]] bool isAbsent() const;
};

/// A directory that was opened, or the reason why it was not. Nothing here waits, writes, or throws
/// anything but std::bad_alloc.
class SysfsDirectory
{
public:
    /// The kernel fills a page at most for an attribute of the common kind.
    static constexpr std::size_t pageSize = 4096;

    explicit SysfsDirectory(const std::string& path);
    /// A directory below another one, or one that a link below it leads to.
    SysfsDirectory(const SysfsDirectory& parent, const std::string& path);

    [[nodiscard]] bool isOpen() const { return descriptor_.isOpen(); }

    /// An errno value: why it is not open; 0: it is.
    [[nodiscard]] int errorCode() const { return errorCode_; }

    /// There is no such directory, or no longer.
    [[nodiscard]] bool isAbsent() const;

    /// The names of all that is in it, sorted; without "." and "..". Empty where it is not open or cannot be
    /// listed.
    [[nodiscard]] std::vector<std::string> names() const;

    /// Of those, the names of directories; not of links to them.
    [[nodiscard]] std::vector<std::string> directories() const;

    // For a directory that is open.

    /// Where a link leads, as it stands there. Nothing: there is no link of that name.
    [[nodiscard]] std::optional<std::string> linkTarget(const std::string& name) const;

    /// Whether that directory is, still, what the name leads to.
    [[nodiscard]] bool leadsTo(const SysfsDirectory& directory, const std::string& name) const;

    /// The beginning of a file, of that name or at the end of that path below. A pipe counts as unreadable.
    [[nodiscard]] SysfsAttribute attribute(const std::string& name, std::size_t mostBytes = pageSize) const;

private:
    SysfsDirectory(int base, const std::string& path);
    template <class IsWanted>
    [[nodiscard]] std::vector<std::string> entries(IsWanted isWanted) const;
    [[nodiscard]] bool hasDirectory(const char* name) const;

    Descriptor descriptor_;
    int errorCode_;
};

} // namespace Tavro

#endif
