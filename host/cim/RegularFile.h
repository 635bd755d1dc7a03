/// \file
#ifndef CIMHOST_CIM_REGULARFILE_H
#define CIMHOST_CIM_REGULARFILE_H

#include "cim/Descriptor.h"

#include <cstddef>
#include <stdexcept>
#include <string>

namespace cimhost::cim {

/// A file is not what was asked for; what() says what was found, without the file's name.
class FileError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// A regular file, open for reading. Anything else is refused without reading it or waiting for it: a
/// pipe or a device might never end.
class RegularFile
{
public:
    /// \throws FileError
    explicit RegularFile(const std::string& name);

    /// What is left to read.
    /// \param mostBytes  more is refused
    /// \throws FileError
    [[nodiscard]] std::string read(std::size_t mostBytes) const;

private:
    Descriptor descriptor_;
};

} // namespace cimhost::cim

#endif
