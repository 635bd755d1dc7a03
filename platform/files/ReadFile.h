/// \file
#ifndef TAVRO_READFILE_H
#define TAVRO_READFILE_H

#include <cstddef>
#include <stdexcept>
#include <string>

namespace Tavro {

/// A file is not what was asked for; what() says what was found and what was expected, without the
/// file's name.
class ReadFailure : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// There is no file of that name.
class FileMissing : public ReadFailure
{
public:
    using ReadFailure::ReadFailure;
};

/// The content of a regular file. A pipe or device is refused, not read: it might never end.
/// \param mostBytes  a longer file is refused
/// \throw ReadFailure
std::string readFile(const std::string& name, std::size_t mostBytes);

} // namespace Tavro

#endif
