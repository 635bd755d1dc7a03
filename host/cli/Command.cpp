#include "cli/Command.h"

namespace cimhost::cli {

bool answersPaths(Operation operation)
{
    switch (operation) {
    case Operation::enumerateInstanceNames:
    case Operation::associatorNames:
    case Operation::referenceNames:
        return true;
    default:
        return false;
    }
}

Format formatOf(const Command& command, bool isTerminal)
{
    const bool isForPeople = isTerminal && !answersPaths(command.operation);
    return command.format.value_or(isForPeople ? Format::table : Format::text);
}

} // namespace cimhost::cli
