#include "cli/Program.h"

#include "broker/Broker.h"
#include "broker/Habits.h"
#include "cli/Arguments.h"
#include "cli/Execute.h"
#include "cli/Reports.h"
#include "schema/MofReader.h"

#include <exception>
#include <ostream>
#include <utility>
#include <variant>

namespace cimhost::cli {

namespace {

ExitStatus follow(const Invocation& invocation, const Surroundings& surroundings, bool isTerminal,
                  std::ostream& out, std::ostream& err)
{
    const Settings& settings = invocation.settings;
    Registration registration = readRegistrations(findRegistrationFiles(settings, surroundings));
    if (settings.inventory)
        useInventory(*settings.inventory);
    Broker broker(std::move(registration), findProviderDirectories(settings, surroundings),
                  reportTo(err, settings.trace), settings.like ? findHabits(*settings.like) : nullptr,
                  readClasses(findSchemaFiles(settings, surroundings)));
    return execute(invocation.command, broker, isTerminal, out, err);
}

ExitStatus fail(const std::exception& error, ExitStatus status, std::ostream& err)
{
    err << "cimhost: " << error.what() << '\n';
    return status;
}

} // namespace

ExitStatus run(const std::vector<std::string>& arguments, const Surroundings& surroundings, bool isTerminal,
               std::ostream& out, std::ostream& err)
{
    try {
        const std::variant<Invocation, Notice> parsed = parseArguments(arguments);
        if (const auto* invocation = std::get_if<Invocation>(&parsed))
            return follow(*invocation, surroundings, isTerminal, out, err);
        out << std::get<Notice>(parsed).text;
        return exitAnswered;
    } catch (const UsageError& error) {
        return fail(error, exitUsage, err);
    } catch (const RegistrationError& error) {
        return fail(error, exitUsage, err);
    } catch (const schema::MofError& error) {
        return fail(error, exitUsage, err);
    } catch (const std::exception& error) {
        return fail(error, exitError, err);
    }
}

} // namespace cimhost::cli
