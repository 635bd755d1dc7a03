#include "cli/Output.h"

#include "cim/Json.h"
#include "cim/Literal.h"
#include "cim/Mof.h"
#include "cim/ObjectPathText.h"
#include "cim/StatusCode.h"
#include "cim/Utf8.h"
#include "cli/InstanceTable.h"

namespace cimhost::cli {

namespace {

std::string text(const cim::ObjectPath& path)
{
    return cim::toText(path) + '\n';
}

std::string text(const cim::Instance& instance)
{
    std::string result = cim::toText(instance.path) + '\n';
    for (const cim::Property& property : instance.properties)
        result += "  " + cim::printable(property.name) + " = " + cim::literal(property.value) + '\n';
    return result;
}

/// The objects one after the other, the separator between them.
template <typename Object, typename Show>
std::string joined(const cim::SharedList<Object>& objects, const char* separator, Show show)
{
    std::string result;
    for (const Object& object : objects)
        result += (result.empty() ? "" : separator) + show(object);
    return result;
}

template <typename Object>
cim::Json jsonList(const cim::SharedList<Object>& objects)
{
    cim::Json list = cim::Json::array();
    for (const Object& object : objects)
        list.push_back(cim::toJson(object));
    return list;
}

std::string pathsText(const cim::ObjectPaths& paths, Format format, std::size_t width)
{
    if (format == Format::table)
        return nameTable(paths, width);
    if (format == Format::mof)
        return joined(paths, "\n", [](const cim::ObjectPath& path) { return cim::mof(path); });
    return joined(paths, "", [](const cim::ObjectPath& path) { return text(path); });
}

std::string instancesText(const cim::Instances& instances, const OperationRequest& request, Format format,
                          std::size_t width)
{
    if (format == Format::mof)
        return joined(instances, "\n", [](const cim::Instance& instance) { return cim::mof(instance); });
    if (format == Format::text)
        return joined(instances, "\n", [](const cim::Instance& instance) { return text(instance); });
    // Who asks for one instance wants to see all of it.
    if (request.operation == Operation::getInstance)
        return instanceBlocks(instances);
    return instanceTable(instances, request.properties, width);
}

} // namespace

std::string answerText(const cim::Answer& answer, const OperationRequest& request, Format format,
                       std::size_t width)
{
    const bool paths = answersPaths(request.operation);
    if (format == Format::json)
        return cim::toText(cim::Json{
            {"status", cim::toJson(answer.status)},
            {paths ? "paths" : "instances", paths ? jsonList(answer.paths) : jsonList(answer.instances)}});
    return paths ? pathsText(answer.paths, format, width)
                 : instancesText(answer.instances, request, format, width);
}

std::string errorText(const cim::Status& status, Format format)
{
    return format == Format::json ? cim::toText(cim::Json{{"status", cim::toJson(status)}}) : "";
}

std::string statusLine(const cim::Status& status)
{
    const std::string code = cim::statusName(status.code) + " (" + std::to_string(status.code) + ')';
    return status.message ? code + ": " + cim::printable(*status.message) : code;
}

} // namespace cimhost::cli
