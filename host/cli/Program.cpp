#include "cli/Program.h"

#include "broker/Broker.h"
#include "broker/Habits.h"
#include "cli/Arguments.h"
#include "cli/Defaults.h"
#include "cli/Execute.h"
#include "cli/Reports.h"
#include "schema/MofReader.h"

#include <exception>
#include <ostream>
#include <utility>
#include <variant>

namespace cimhost::cli {

namespace {

Ending follow(const Invocation& invocation, const Surroundings& surroundings,
              std::optional<std::size_t> columns, std::ostream& out, std::ostream& err)
{
    const Settings& settings = invocation.settings;
    const std::vector<std::string> files = findRegistrationFiles(settings, surroundings);
    Registration registration = readRegistrations(files);
    const Defaults defaults = readDefaults(files, surroundings);
    const Command command = complete(invocation.command, defaults);
    if (settings.inventory)
        useInventory(*settings.inventory, defaults);
    Broker broker(std::move(registration), findProviderDirectories(settings, surroundings),
                  reportTo(err, settings.trace), settings.like ? findHabits(*settings.like) : nullptr,
                  readClasses(findSchemaFiles(settings, surroundings)));
    return {execute(command, broker, columns, out, err), std::holds_alternative<DrawGraph>(command)};
}

Ending fail(const std::exception& error, ExitStatus status, std::ostream& err)
{
    err << "cimhost: " << error.what() << '\n';
    return {status};
}

} // namespace

Ending run(const std::vector<std::string>& arguments, const Surroundings& surroundings,
           std::optional<std::size_t> columns, std::ostream& out, std::ostream& err)
{
    try {
        const std::variant<Invocation, Notice> parsed = parseArguments(arguments);
        if (const auto* invocation = std::get_if<Invocation>(&parsed))
            return follow(*invocation, surroundings, columns, out, err);
        out << std::get<Notice>(parsed).text;
        return {exitAnswered};
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
