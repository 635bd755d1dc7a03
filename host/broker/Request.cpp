#include "broker/Broker.h"
#include "broker/BrokerImplementation.h"
#include "broker/Call.h"
#include "broker/Scope.h"
#include "broker/Values.h"
#include "cim/Values.h"

namespace cimhost {

namespace {

ContextObject requestEntries()
{
    return {{{"CMPIInvocationFlags", cim::unsignedValue(0, CMPI_uint32)},
             {"CMPIPrincipal", cim::textValue("cimhost")}}};
}

/// The live object of that kind behind an envelope; null when there is none. Reports nothing.
template <class Object>
const Object* find(const EnvelopeOf<Object>* object)
{
    if (object == nullptr)
        return nullptr;
    const Handle* const handle = HandleSpace::instance().find(object->hdl);
    if (handle == nullptr || handle->state.load(std::memory_order_acquire) != State::live ||
        handle->kind != Traits<Object>::kind)
        return nullptr;
    return &contentOf<Object>(*handle);
}

} // namespace

class Request::Implementation
{
public:
    explicit Implementation(Core& requestCore)
        : core(requestCore),
          scope(requestCore),
          context(make<ContextObject>(core, requestEntries())),
          resultHandle(scope.store().add(std::make_unique<ResultObject>()))
    {}

    [[nodiscard]] ResultObject& content() const { return contentOf<ResultObject>(resultHandle); }

    Core& core;
    Scope scope;
    const CMPIContext* context;
    Handle& resultHandle;
};

Request::Request(Broker& broker)
    : implementation_(std::make_unique<Implementation>(broker.implementation_->core))
{}

Request::~Request() = default;

const CMPIContext* Request::context()
{
    return implementation_->context;
}

const CMPIResult* Request::result()
{
    return envelopeOf<ResultObject>(implementation_->resultHandle);
}

CMPIObjectPath* Request::path(const cim::ObjectPath& path)
{
    return make<ObjectPathObject>(implementation_->core, cim::CopyOnWrite<cim::ObjectPath>(path));
}

CMPIInstance* Request::instance(const cim::Instance& instance)
{
    return make<InstanceObject>(implementation_->core, std::make_shared<const cim::Instance>(instance));
}

cim::Answer Request::answer(const CMPIStatus& status) const
{
    cim::Answer answer;
    answer.status.code = status.rc;
    if (status.msg != nullptr) {
        // A message that is no message is the provider's misuse, but not worth losing the answer.
        serve("the operation's status", nullptr, false, [&](Call& call) {
            answer.status.message = call.use<StringObject>(status.msg, "the message").text;
            return true;
        });
    }
    const ResultObject& content = implementation_->content();
    answer.paths = content.paths;
    answer.instances = content.instances;
    return answer;
}

int Request::doneCount() const
{
    return implementation_->content().doneCount;
}

std::optional<cim::ObjectPath> read(const CMPIObjectPath* path)
{
    const auto* const content = find<ObjectPathObject>(path);
    return content == nullptr ? std::nullopt : std::make_optional(content->path.read());
}

std::optional<cim::Instance> read(const CMPIInstance* instance)
{
    const auto* const content = find<InstanceObject>(instance);
    return content == nullptr ? std::nullopt : std::make_optional(*completed(*content));
}

std::optional<std::string> read(const CMPIString* string)
{
    const auto* const content = find<StringObject>(string);
    return content == nullptr ? std::nullopt : std::make_optional(content->text);
}

} // namespace cimhost
