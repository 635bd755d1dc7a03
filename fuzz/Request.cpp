// Request messages of CIM-XML: read, or refused with a line that may go to a terminal. What is read is
// answered, and an instance that was read is written so that it is read again as the same. What a document has is
// counted before it is read as what is found in it.

#include "FuzzTarget.h"

#include "cim/Utf8.h"
#include "cim/Values.h"
#include "serve/Dtd.h"
#include "serve/RequestReader.h"
#include "serve/ResponseWriter.h"
#include "serve/ValueReader.h"
#include "serve/ValueWriter.h"

#include <algorithm>
#include <string>
#include <utility>

using namespace cimhost;
using namespace cimhost::serve;

namespace {

/// Enough for what is inside of any message.
constexpr XmlLimits wide{1000, 1000000, 1000000, 1000000, 1000000};

Element parse(const std::string& document)
{
    return parseXml(document, wide, &isKnownElement);
}

/// What was found in an element, itself included.
XmlLimits countsOf(const Element& element)
{
    XmlLimits counts{1, 1, element.attributes.size(), element.attributes.size(), 0};
    for (const Element& child : element.children) {
        const XmlLimits inside = countsOf(child);
        counts.depth = std::max(counts.depth, inside.depth + 1);
        counts.elements += inside.elements;
        counts.attributes += inside.attributes;
        counts.attributesOfElement = std::max(counts.attributesOfElement, inside.attributesOfElement);
    }
    return counts;
}

bool isWithin(const XmlLimits& limits, std::string_view document)
{
    try {
        requireWithin(limits, document);
        return true;
    } catch (const RequestError& error) {
        Fuzz::require(error.fault() == Fault::tooLarge, "it is refused for its size alone");
        return false;
    }
}

/// With a limit that is too small by one it is refused. Names with a prefix are counted and not found.
void checkCounts(const std::string& document)
{
    const XmlLimits counts =
        countsOf(parseXml(document, wide, [](std::string_view /*name*/) { return true; }));
    XmlLimits exact = wide;
    exact.depth = counts.depth;
    exact.elements = counts.elements;
    Fuzz::require(isWithin(exact, document), "no more elements are counted than there are");
    for (std::size_t XmlLimits::*limit :
         {&XmlLimits::depth, &XmlLimits::elements, &XmlLimits::attributes, &XmlLimits::attributesOfElement}) {
        XmlLimits narrow = wide;
        if (counts.*limit == 0)
            continue;
        narrow.*limit = counts.*limit - 1;
        Fuzz::require(!isWithin(narrow, document), "nothing is there that is not counted");
    }
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
        checkCounts(Fuzz::textOf(data, size));
    } catch (const RequestError&) {
        // It is no document.
    }
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
