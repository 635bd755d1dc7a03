/// \file
/// Answers as text in the format asked for.
#ifndef CIMHOST_CLI_OUTPUT_H
#define CIMHOST_CLI_OUTPUT_H

#include "cim/Model.h"
#include "cli/Command.h"
#include "cli/FittedTable.h"

#include <string>

namespace cimhost::cli {

/// What an answer brought. In JSON it comes with the status: `{ "status": ..., "paths": [...] }` or
/// `{ "status": ..., "instances": [...] }`.
/// \param width  of the terminal, for tables
std::string answerText(const cim::Answer& answer, const OperationRequest& request, Format format,
                       std::size_t width = anyWidth);

/// An answer with an error status as standard output has it: in JSON `{ "status": ... }`, else nothing.
std::string errorText(const cim::Status& status, Format format);

/// The status in one line, `CMPI_RC_ERR_FAILED (1): the provider's message`.
std::string statusLine(const cim::Status& status);

} // namespace cimhost::cli

#endif
