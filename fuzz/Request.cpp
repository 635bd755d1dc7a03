// Request messages of CIM-XML: read, or refused with a line that may go to a terminal. What is read is
// answered, and an instance that was read is written so that it is read again as the same.

#include "FuzzTarget.h"

#include "cim/Utf8.h"
#include "cim/Values.h"
#include "serve/Dtd.h"
#include "serve/RequestReader.h"
#include "serve/ResponseWriter.h"
#include "serve/ValueReader.h"
#include "serve/ValueWriter.h"

using namespace cimhost;
using namespace cimhost::serve;

namespace {

/// Enough for what is inside of any message.
constexpr XmlLimits wide{1000, 1000000};

Element parse(const std::string& document)
{
    return parseXml(document, wide, &isKnownElement);
}

void checkRoundTrip(cim::Instance instance)
{
    XmlWriter xml;
    writeInstance(xml, instance);
    instance.path = {"", "", instance.path.className, {}};
    Fuzz::require(readInstance(parse(xml.document()), wide) == instance,
                  "an instance is read as it was written");
}

void checkResponse(const RequestMessage& message)
{
    Reply reply;
    cim::Answer& answer = reply.answer;
    if (const auto* const status = std::get_if<cim::Status>(&message.content)) {
        Fuzz::require(status->code != CMPI_RC_OK && status->message.has_value(), "a refusal has its reason");
        answer.status = *status;
    } else {
        const auto& request = std::get<Question>(message.content).request;
        Fuzz::require(request.target.nameSpace == message.nameSpace,
                      "a request is for the message's namespace");
        answer.paths.push_back(request.target);
        answer.instances.push_back(request.instance);
    }
    parse(writeResponse(message, std::move(reply), "here").whole());
}

} // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    try {
        const RequestMessage message = readRequest(Fuzz::textOf(data, size));
        checkResponse(message);
        if (const auto* const question = std::get_if<Question>(&message.content))
            checkRoundTrip(question->request.instance);
    } catch (const UnwritableError&) {
        // A reference to nothing; a request may have it, a provider may not return it.
    } catch (const RequestError& error) {
        const std::string message = error.what();
        Fuzz::require(!message.empty() && cim::printable(message) == message,
                      "a refusal may go to a terminal");
    }
    return 0;
}
