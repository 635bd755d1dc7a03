#include "cli/Program.h"

#include "broker/Broker.h"
#include "broker/Habits.h"
#include "cli/Arguments.h"
#include "cli/Defaults.h"
#include "cli/Execute.h"
#include "cli/Metrics.h"
#include "cli/Reports.h"
#include "schema/MofReader.h"

#include <exception>
#include <memory>
#include <ostream>
#include <utility>
#include <variant>

namespace cimhost::cli {

namespace {

/// \throws UsageError, RegistrationError, schema::MofError
std::unique_ptr<Broker> startBroker(const Settings& settings, const Surroundings& surroundings,
                                    const std::vector<std::string>& registrationFiles,
                                    const Defaults& defaults, std::ostream& err)
{
    Registration registration = readRegistrations(registrationFiles);
    if (settings.inventory)
        useInventory(*settings.inventory, defaults);
    return std::make_unique<Broker>(std::move(registration), findProviderDirectories(settings, surroundings),
                                    reportTo(err, settings.trace),
                                    settings.like ? findHabits(*settings.like) : nullptr,
                                    readClasses(findSchemaFiles(settings, surroundings)));
}

Ending follow(const Invocation& invocation, const Surroundings& surroundings,
              std::optional<std::size_t> columns, std::ostream& out, std::ostream& err)
{
    const Settings& settings = invocation.settings;
    const std::vector<std::string> files = findRegistrationFiles(settings, surroundings);
    const Defaults defaults = readDefaults(files, surroundings);
    const Command command = complete(invocation.command, defaults);
    const std::unique_ptr<Broker> broker = startBroker(settings, surroundings, files, defaults, err);
    return {execute(command, *broker, columns, out, err), std::holds_alternative<DrawGraph>(command)};
}

/// Starting the broker is a part of what is measured, and its failure one of what is shown.
Ending measure(const Measurement& measurement, const Surroundings& surroundings, std::ostream& out,
               std::ostream& err)
{
    const Settings& settings = measurement.settings;
    const StartBroker start = [&] {
        const std::vector<std::string> files = findRegistrationFiles(settings, surroundings);
        return startBroker(settings, surroundings, files, readDefaults(files, surroundings), err);
    };
    return {writeMetrics(measurement.metrics, start, out, err)};
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
        const std::variant<Invocation, Measurement, Notice> parsed = parseArguments(arguments);
        if (const auto* invocation = std::get_if<Invocation>(&parsed))
            return follow(*invocation, surroundings, columns, out, err);
        if (const auto* measurement = std::get_if<Measurement>(&parsed))
            return measure(*measurement, surroundings, out, err);
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
