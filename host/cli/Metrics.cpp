#include "cli/Metrics.h"

#include "cim/Utf8.h"
#include "cli/metrics/AlarmDevices.h"
#include "cli/metrics/Apart.h"
#include "cli/metrics/ReplaceFile.h"

#include <chrono>
#include <ostream>
#include <string>

namespace cimhost::cli {

namespace {

/// The gauges; nothing where there is no picture, and `err` has a line.
std::string collect(const Metrics& command, const StartBroker& start, std::ostream& err)
{
    const auto ask = [&] {
        const std::unique_ptr<Broker> broker = start();
        return alarmDeviceGauges(broker->enumerateInstances(command.target, alarmDeviceProperties()));
    };
    try {
        return doApart(ask, command.limit);
    } catch (const ApartError& error) {
        err << "cimhost: no metrics: " << error.what() << '\n';
        return "";
    }
}

} // namespace

ExitStatus writeMetrics(const Metrics& command, const StartBroker& start, std::ostream& out,
                        std::ostream& err)
{
    const auto began = std::chrono::steady_clock::now();
    const std::string gauges = collect(command, start, err);
    const Collection collection{!gauges.empty(), std::chrono::steady_clock::now() - began,
                                std::chrono::system_clock::now()};
    const std::string text = gauges + collectionGauges(collection);
    if (command.output)
        replaceFile(*command.output, text);
    else
        out << text;
    return collection.isSuccessful ? exitAnswered : exitError;
}

} // namespace cimhost::cli
