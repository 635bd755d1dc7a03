#include "serve/ResponseWriter.h"

#include "cim/StatusCode.h"
#include "cim/Utf8.h"
#include "serve/ValueWriter.h"
#include "serve/XmlWriter.h"

#include <optional>

namespace cimhost::serve {

namespace {

/// The path as a client elsewhere needs it: with host and namespace.
cim::ObjectPath located(cim::ObjectPath path, const RequestMessage& request, const std::string& hostName)
{
    if (path.host.empty())
        path.host = hostName;
    if (path.nameSpace.empty())
        path.nameSpace = request.nameSpace;
    return path;
}

/// IRETURNVALUE, in the form that each operation has (DMTF DSP0200, 5.4).
class ReturnValueWriter
{
public:
    ReturnValueWriter(XmlWriter& xml, const RequestMessage& request, const cim::Answer& answer,
                      const std::string& hostName)
        : xml_(xml),
          request_(request),
          answer_(answer),
          hostName_(hostName)
    {}

    void write(Operation operation)
    {
        switch (operation) {
        case Operation::modifyInstance:
        case Operation::deleteInstance:
            return; // nothing is returned
        default:
            xml_.element("IRETURNVALUE", [&] { writeContent(operation); });
        }
    }

private:
    void writeContent(Operation operation)
    {
        switch (operation) {
        case Operation::enumerateInstanceNames:
        case Operation::createInstance:
            for (const cim::ObjectPath& path : answer_.paths)
                writeInstanceName(xml_, path);
            break;
        case Operation::enumerateInstances:
            for (const cim::Instance& instance : answer_.instances)
                writeNamedInstance(instance);
            break;
        case Operation::getInstance:
            writeInstance(xml_, answer_.instances.front());
            break;
        case Operation::execQuery:
            for (const cim::Instance& instance : answer_.instances)
                xml_.element("VALUE.OBJECT", [&] { writeInstance(xml_, instance); });
            break;
        case Operation::associators:
        case Operation::references:
            for (const cim::Instance& instance : answer_.instances)
                writeObjectWithPath(instance);
            break;
        case Operation::associatorNames:
        case Operation::referenceNames:
            for (const cim::ObjectPath& path : answer_.paths)
                xml_.element("OBJECTPATH",
                             [&] { writeInstancePath(xml_, located(path, request_, hostName_)); });
            break;
        default:
            break;
        }
    }

    void writeNamedInstance(const cim::Instance& instance)
    {
        xml_.element("VALUE.NAMEDINSTANCE", [&] {
            writeInstanceName(xml_, instance.path);
            writeInstance(xml_, instance);
        });
    }

    void writeObjectWithPath(const cim::Instance& instance)
    {
        xml_.element("VALUE.OBJECTWITHPATH", [&] {
            writeInstancePath(xml_, located(instance.path, request_, hostName_));
            writeInstance(xml_, instance);
        });
    }

    XmlWriter& xml_;
    const RequestMessage& request_;
    const cim::Answer& answer_;
    const std::string& hostName_;
};

/// The document around the body of a response.
template <class Body>
std::string messageWith(const RequestMessage& request, const Body& body)
{
    XmlWriter xml;
    xml.declaration();
    xml.element("CIM", [&] {
        xml.attribute("CIMVERSION", "2.0");
        xml.attribute("DTDVERSION", "2.0");
        xml.element("MESSAGE", [&] {
            xml.attribute("ID", request.id);
            xml.attribute("PROTOCOLVERSION", "1.0");
            xml.element("SIMPLERSP", [&] {
                xml.element(request.isIntrinsic ? "IMETHODRESPONSE" : "METHODRESPONSE", [&] {
                    xml.attribute("NAME", request.method);
                    body(xml);
                });
            });
        });
    });
    return xml.document();
}

/// The codes of CIM's own are those of CMPI, up to the last of them.
constexpr CMPIrc lastCimStatus = CMPI_RC_ERR_METHOD_NOT_FOUND;

std::string writeError(const RequestMessage& request, const cim::Status& status)
{
    const bool isCims = status.code <= lastCimStatus;
    const std::string message =
        status.message.value_or(isCims ? std::string() : cim::statusName(status.code));
    return messageWith(request, [&](XmlWriter& xml) {
        xml.element("ERROR", [&] {
            xml.attribute("CODE", std::to_string(isCims ? status.code : CMPI_RC_ERR_FAILED));
            if (!message.empty())
                xml.attribute("DESCRIPTION", message);
        });
    });
}

} // namespace

std::string writeResponse(const RequestMessage& request, const cim::Answer& answer,
                          const std::string& hostName)
{
    const auto* const operation = std::get_if<OperationRequest>(&request.content);
    if (answer.status.code != CMPI_RC_OK || operation == nullptr)
        return writeError(request, answer.status);
    try {
        return messageWith(request, [&](XmlWriter& xml) {
            ReturnValueWriter(xml, request, answer, hostName).write(operation->operation);
        });
    } catch (const UnwritableError& error) {
        return writeError(request,
                          {CMPI_RC_ERR_FAILED, std::string("the provider returned ") + error.what()});
    }
}

} // namespace cimhost::serve
