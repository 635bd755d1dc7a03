#include "cli/Command.h"

namespace cimhost::cli {

Format formatOf(const Ask& ask, bool isTerminal)
{
    const bool isForPeople = isTerminal && !answersPaths(ask.request.operation);
    return ask.format.value_or(isForPeople ? Format::table : Format::text);
}

} // namespace cimhost::cli
