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

using Began = std::chrono::steady_clock::time_point;

/// The whole picture. \param gauges  empty: there is none of the devices
std::string pictureOf(const std::string& gauges, Began began)
{
    return gauges + collectionGauges({!gauges.empty(), std::chrono::steady_clock::now() - began,
                                      std::chrono::system_clock::now()});
}

std::string ask(const cim::ObjectPath& target, Broker& broker)
{
    return alarmDeviceGauges(broker.enumerateInstances(target, alarmDeviceProperties()));
}

/// The gauges; nothing where there is no picture, and `err` has a line.
std::string collect(const Metrics& command, const StartBroker& start, std::ostream& err)
{
    const auto work = [&] { return ask(command.target, *start()); };
    try {
        return doApart(work, command.limit);
    } catch (const ApartError& error) {
        err << "cimhost: no metrics: " << error.what() << '\n';
        return "";
    }
}

} // namespace

std::string expositionOf(const cim::ObjectPath& target, Broker& broker)
{
    const Began began = std::chrono::steady_clock::now();
    try {
        return pictureOf(ask(target, broker), began);
    } catch (const NoPicture&) {
        return pictureOf("", began);
    }
}

ExitStatus writeMetrics(const Metrics& command, const StartBroker& start, std::ostream& out,
                        std::ostream& err)
{
    const Began began = std::chrono::steady_clock::now();
    const std::string gauges = collect(command, start, err);
    const std::string text = pictureOf(gauges, began);
    if (command.output)
        replaceFile(*command.output, text);
    else
        out << text;
    return gauges.empty() ? exitError : exitAnswered;
}

} // namespace cimhost::cli
