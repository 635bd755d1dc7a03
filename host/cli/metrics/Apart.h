/// \file
/// Work in a process of its own.
#ifndef CIMHOST_CLI_METRICS_APART_H
#define CIMHOST_CLI_METRICS_APART_H

#include <chrono>
#include <functional>
#include <stdexcept>
#include <string>

namespace cimhost::cli {

/// Why there is no result.
class ApartError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// Does the work in a child of this process, which must have no other thread: what crashes, ends the process or
/// hangs there does not do so here.
/// \param limit  the child is killed when it takes longer
/// \return what the work returned
/// \throws ApartError  with the message of the work's exception, or what became of the child
std::string doApart(const std::function<std::string()>& work, std::chrono::milliseconds limit);

} // namespace cimhost::cli

#endif
