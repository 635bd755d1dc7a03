#include "serve/Executor.h"

#include "serve/ClassRequests.h"
#include "serve/ValueReader.h"

#include <algorithm>

namespace cimhost::serve {

namespace {

/// Takes away what a class deriving from the one asked for adds.
void dropAddedProperties(cim::Answer& answer, const std::string& className, const schema::Classes& classes)
{
    if (classes.find(className) == nullptr)
        return;
    const auto isAdded = [&](const cim::Property& property) {
        return classes.originOf(className, property.name).empty();
    };
    answer.instances.edit([&](cim::Instance& instance) {
        auto& properties = instance.properties;
        properties.erase(std::remove_if(properties.begin(), properties.end(), isAdded), properties.end());
    });
}

cim::Answer ask(const Question& question, Broker& broker)
{
    OperationRequest request = question.request;
    typeKeys(request.target, broker.classes());
    if (request.operation == Operation::modifyInstance)
        request.instance.path = request.target;
    cim::Answer answer = perform(request, broker);
    if (request.operation == Operation::enumerateInstances && !question.deepInheritance.value_or(true))
        dropAddedProperties(answer, request.target.className, broker.classes());
    return answer;
}

Reply open(const Question& question, Broker& broker, Enumerations& enumerations)
{
    enumerations.checkOpening(question);
    cim::Answer answer = ask(question, broker);
    if (answer.status.code != CMPI_RC_OK)
        return {std::move(answer)};
    return enumerations.open(question, std::move(answer));
}

Reply carryOut(const Question& question, Broker& broker, Enumerations& enumerations)
{
    switch (question.step) {
    case Step::ask:
        return {ask(question, broker)};
    case Step::open:
        return open(question, broker, enumerations);
    case Step::pull:
        return enumerations.pull(question);
    case Step::close:
        enumerations.close(question);
        return {};
    case Step::count: {
        Reply reply;
        reply.count = enumerations.count(question);
        return reply;
    }
    default:
        return findClasses(question, broker);
    }
}

} // namespace

Reply execute(const RequestMessage& message, Broker& broker, Enumerations& enumerations)
{
    if (const auto* status = std::get_if<cim::Status>(&message.content))
        return {{*status, {}, {}}};
    try {
        return carryOut(std::get<Question>(message.content), broker, enumerations);
    } catch (const ValueError& error) {
        return {{{error.code(), error.what()}, {}, {}}};
    }
}

} // namespace cimhost::serve
