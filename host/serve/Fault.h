/// \file
/// What keeps a request message from being carried out at all. A client is told by the HTTP status; what
/// goes wrong later is told by a status of CIM.
#ifndef CIMHOST_SERVE_FAULT_H
#define CIMHOST_SERVE_FAULT_H

#include <stdexcept>
#include <string>

namespace cimhost::serve {

/// The faults that DMTF DSP0200 names in its header CIMError, and one of our own.
enum class Fault
{
    notWellFormed,   ///< not XML, or not in UTF-8
    notValid,        ///< with a document type declaration, which is never read
    notLooselyValid, ///< not what the DTD of DMTF DSP0203 allows, even without what it does not know
    tooLarge,        ///< beyond one of our limits
    unsupportedProtocolVersion, ///< not 1.x
    unsupportedCimVersion,      ///< not 2.x
    unsupportedDtdVersion,      ///< not 2.x
    multipleRequests,           ///< several requests in one message
    unsupportedOperation,       ///< an export instead of an operation
    headerMismatch,             ///< header and message say different things
};

/// what() names the place and what was expected there, in one printable line.
class RequestError : public std::runtime_error
{
public:
    RequestError(Fault fault, const std::string& message) : std::runtime_error(message), fault_(fault) {}

    [[nodiscard]] Fault fault() const noexcept { return fault_; }

private:
    Fault fault_;
};

} // namespace cimhost::serve

#endif
