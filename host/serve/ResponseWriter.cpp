#include "serve/ResponseWriter.h"

#include "cim/StatusCode.h"
#include "cim/Utf8.h"
#include "serve/ClassWriter.h"
#include "serve/ValueWriter.h"
#include "serve/XmlWriter.h"

#include <optional>
#include <utility>

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

/// What stands in a good response, in the form that each operation has (DMTF DSP0200, 5.4).
class BodyWriter
{
public:
    BodyWriter(XmlWriter& xml, const RequestMessage& request, const Question& question, Reply& reply,
               const std::string& hostName, const schema::Classes& classes)
        : xml_(xml),
          request_(request),
          question_(question),
          reply_(reply),
          answer_(reply.answer),
          hostName_(hostName),
          origins_(question.includeClassOrigin.value_or(false) ? &classes : nullptr)
    {}

    /// What has been written goes: its text takes less memory than it does.
    void write()
    {
        switch (question_.step) {
        case Step::ask:
            return writeAnswer(question_.request.operation);
        case Step::close:
            return; // nothing is returned
        case Step::count:
            return returned([&] { xml_.element("VALUE", [&] { xml_.text(std::to_string(reply_.count)); }); });
        case Step::open:
        case Step::pull:
            return writePiece();
        default:
            return returned([&] { writeClasses(); });
        }
    }

private:
    template <class Content>
    void returned(const Content& content)
    {
        xml_.element("IRETURNVALUE", content);
    }

    void writeAnswer(Operation operation)
    {
        if (operation != Operation::modifyInstance && operation != Operation::deleteInstance)
            returned([&] { writeContent(operation); });
    }

    void writeContent(Operation operation)
    {
        switch (operation) {
        case Operation::enumerateInstanceNames:
        case Operation::createInstance:
            answer_.paths.drain([&](const cim::ObjectPath& path) { writeInstanceName(xml_, path); });
            break;
        case Operation::enumerateInstances:
            answer_.instances.drain([&](const cim::Instance& instance) {
                xml_.element("VALUE.NAMEDINSTANCE", [&] {
                    writeInstanceName(xml_, instance.path);
                    writeInstance(xml_, instance, origins_);
                });
            });
            break;
        case Operation::getInstance:
            writeInstance(xml_, answer_.instances.front(), origins_);
            break;
        case Operation::execQuery:
            answer_.instances.drain([&](const cim::Instance& instance) {
                xml_.element("VALUE.OBJECT", [&] { writeInstance(xml_, instance); });
            });
            break;
        case Operation::associators:
        case Operation::references:
            writeInstancesWithPaths("VALUE.OBJECTWITHPATH");
            break;
        case Operation::associatorNames:
        case Operation::referenceNames:
            answer_.paths.drain(
                [&](const cim::ObjectPath& path) { xml_.element("OBJECTPATH", [&] { writePath(path); }); });
            break;
        default:
            break;
        }
    }

    void writePiece()
    {
        returned([&] {
            answer_.paths.drain([&](const cim::ObjectPath& path) { writePath(path); });
            writeInstancesWithPaths("VALUE.INSTANCEWITHPATH");
        });
        const auto writeOut = [&](const char* name, const char* type, const std::string& value) {
            xml_.element("PARAMVALUE", [&] {
                xml_.attribute("NAME", name);
                xml_.attribute("PARAMTYPE", type);
                xml_.element("VALUE", [&] { xml_.text(value); });
            });
        };
        writeOut("EnumerationContext", "string", reply_.context);
        writeOut("EndOfSequence", "boolean", reply_.context.empty() ? "TRUE" : "FALSE");
    }

    void writeInstancesWithPaths(const char* element)
    {
        answer_.instances.drain([&](const cim::Instance& instance) {
            xml_.element(element, [&] {
                writePath(instance.path);
                writeInstance(xml_, instance, origins_);
            });
        });
    }

    void writePath(const cim::ObjectPath& path)
    {
        writeInstancePath(xml_, located(path, request_, hostName_));
    }

    void writeClasses()
    {
        for (const schema::Class& declaration : reply_.classes)
            if (question_.step == Step::enumerateClassNames)
                xml_.element("CLASSNAME", [&] { xml_.attribute("NAME", declaration.name); });
            else
                writeClass(xml_, declaration);
    }

    XmlWriter& xml_;
    const RequestMessage& request_;
    const Question& question_;
    const Reply& reply_;
    cim::Answer& answer_;
    const std::string& hostName_;
    const schema::Classes* origins_;
};

/// The document around the body of a response.
template <class Body>
Text messageWith(const RequestMessage& request, std::shared_ptr<TextBudget> budget, const Body& body)
{
    XmlWriter xml{Text(std::move(budget))};
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
    return xml.take();
}

/// The codes of CIM's own are the first of CMPI, and those of enumerations in pieces.
bool isCimStatus(CMPIrc code)
{
    return code <= CMPI_RC_ERR_METHOD_NOT_FOUND ||
           (code >= invalidEnumerationContext && code <= serverLimitsExceeded);
}

Text writeError(const RequestMessage& request, const cim::Status& status)
{
    const bool isCims = isCimStatus(status.code);
    const std::string message =
        status.message.value_or(isCims ? std::string() : cim::statusName(status.code));
    return messageWith(request, nullptr, [&](XmlWriter& xml) {
        xml.element("ERROR", [&] {
            xml.attribute("CODE", std::to_string(isCims ? status.code : CMPI_RC_ERR_FAILED));
            if (!message.empty())
                xml.attribute("DESCRIPTION", message);
        });
    });
}

} // namespace

Text writeResponse(const RequestMessage& request, Reply reply, const std::string& hostName,
                   const schema::Classes& classes, std::shared_ptr<TextBudget> budget)
{
    const auto* const question = std::get_if<Question>(&request.content);
    if (reply.answer.status.code != CMPI_RC_OK || question == nullptr)
        return writeError(request, reply.answer.status);
    try {
        return messageWith(request, std::move(budget), [&](XmlWriter& xml) {
            BodyWriter(xml, request, *question, reply, hostName, classes).write();
        });
    } catch (const UnwritableError& error) {
        return writeError(request,
                          {CMPI_RC_ERR_FAILED, std::string("the provider returned ") + error.what()});
    } catch (const TextTooLong& error) {
        return writeError(request, {serverLimitsExceeded, error.what()});
    }
}

} // namespace cimhost::serve
