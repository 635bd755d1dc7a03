// Sequences of operations on the provider library, as no good broker would ask for them: with inventories
// made up, arguments null, objects without handles or tables, calls of the broker that fail and a memory that
// runs out. None of it may do harm, and the same request brings the same answer.
//
// The steps of an input (Script.h), of which those up to the next operation set its stage:
//
//     node KIND DESCRIPTION PATH STATUS ALARM-STATE   one more node; - for no alarm state
//     clear                                           no nodes
//     systems NAME,...                                the computer systems that the broker knows
//     broker|context|result OBJECT                    what the provider is made and called with: own; null;
//                                                     bare: without tables; empty: with empty tables;
//                                                     lost: without a handle
//     fail NTH HOW                                    a call of the broker that fails in the next operation:
//                                                     handle, status, value, state, lost, or a null result
//     exhaust NTH                                     an allocation that fails in the next operation
//
// and the operations, of a PROVIDER Glimmark, Capabilities, ElementCapabilities or SystemDevice. A PATH is an
// object path as text, or null, bare, empty or lost as above:
//
//     ein|di PROVIDER PATH
//     ei|gi|ci|mi PROVIDER PATH PROPERTY,...
//     xq PROVIDER PATH QUERY LANGUAGE
//     ai|ain PROVIDER PATH ASSOCIATION-CLASS RESULT-CLASS ROLE RESULT-ROLE PROPERTY,...
//     ri|rin PROVIDER PATH RESULT-CLASS ROLE PROPERTY,...
//     end PROVIDER TERMINATING                        the clean-up

#include "FuzzTarget.h"
#include "Script.h"

#include "EntryPoints.h"
#include "testing/Allocations.h"
#include "testing/MadeInventory.h"
#include "testing/RecordedLog.h"
#include "testing/RecordingBroker.h"

#include "broker/Broker.h"
#include "cim/ObjectPathText.h"
#include "cim/Values.h"

#include <array>
#include <cstdlib>
#include <functional>
#include <new>
#include <string>
#include <vector>

namespace cim = cimhost::cim;
using cimhost::Broker;
using Fuzz::require;
using Fuzz::Step;

namespace {

struct Provider
{
    const char* name;
    CMPIInstanceMI* (*createInstanceMI)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
    CMPIAssociationMI* (*createAssociationMI)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
};

constexpr std::array<Provider, 4> providers{{
    {"Glimmark", &GlimmarkProfileProvider_Create_InstanceMI, nullptr},
    {"Capabilities", &GlimmarkCapabilitiesProvider_Create_InstanceMI, nullptr},
    {"ElementCapabilities", &GlimmarkElementCapabilitiesProvider_Create_InstanceMI,
     &GlimmarkElementCapabilitiesProvider_Create_AssociationMI},
    {"SystemDevice", &GlimmarkSystemDeviceProvider_Create_InstanceMI,
     &GlimmarkSystemDeviceProvider_Create_AssociationMI},
}};

const Provider* findProvider(const std::string& name)
{
    for (const Provider& provider : providers)
        if (name == provider.name)
            return &provider;
    return nullptr;
}

/// The broker of all inputs. What providers do wrong with it is counted.
struct Host
{
    static cimhost::Listeners listeners(int& misuses)
    {
        return {{}, {}, [&misuses](const std::string&) { ++misuses; }};
    }

    int misuses = 0;
    Broker broker{
        cimhost::readRegistrationFile(FUZZ_REGISTRATION), {FUZZ_PROVIDER_DIRECTORY}, listeners(misuses)};
};

Host& host()
{
    static Host host;
    return host;
}

/// An object as a step names it. Those that are not the request's own live as long as the process.
template <class Object>
Object* objectCalled(const std::string& word, Object* own)
{
    static const std::remove_pointer_t<decltype(Object::ft)> emptyTable{};
    static Object bare{};
    static Object empty{};
    static Object lost{};
    if (own == nullptr || word == "null")
        return nullptr;
    bare.hdl = empty.hdl = own->hdl;
    empty.ft = &emptyTable;
    lost.ft = own->ft;
    return word == "bare" ? &bare : word == "empty" ? &empty : word == "lost" ? &lost : own;
}

const CMPIBroker* brokerCalled(const std::string& word)
{
    static const CMPIBrokerFT emptyServices{};
    static const CMPIBrokerEncFT emptyEncapsulation{};
    static CMPIBroker bare{};
    static CMPIBroker empty{};
    static CMPIBroker lost{};
    const CMPIBroker* const own = host().broker.cmpiBroker();
    empty.bft = &emptyServices;
    empty.eft = &emptyEncapsulation;
    lost = *own;
    lost.hdl = nullptr;
    return word == "null"    ? nullptr
           : word == "bare"  ? &bare
           : word == "empty" ? &empty
           : word == "lost"  ? &lost
                             : own;
}

/// A property list as a broker hands it over.
class NameList
{
public:
    explicit NameList(const std::optional<std::vector<std::string>>& names)
        : texts_(names.value_or(std::vector<std::string>())),
          isNull_(!names)
    {
        for (const std::string& text : texts_)
            pointers_.push_back(text.c_str());
        pointers_.push_back(nullptr);
    }

    const char** pointer() { return isNull_ ? nullptr : pointers_.data(); }

private:
    std::vector<std::string> texts_;
    std::vector<const char*> pointers_;
    bool isNull_;
};

const char* pointerTo(const std::optional<std::string>& text)
{
    return text ? text->c_str() : nullptr;
}

/// What the steps so far have set.
struct Stage
{
    std::vector<MadeInventory::Node> nodes;
    std::string broker = "own";
    std::string context = "own";
    std::string result = "own";
    unsigned int failingCall = 0; ///< from 1; 0: none
    Failure failure = Failure::nullResult;
    unsigned int failingAllocation = 0; ///< from 1; 0: none

    [[nodiscard]] bool isWhole() const { return failingCall == 0 && failingAllocation == 0; }
    [[nodiscard]] bool isOwn() const { return broker == "own" && context == "own" && result == "own"; }
};

Failure failureCalled(const std::string& word)
{
    return word == "handle"   ? Failure::noHandle
           : word == "status" ? Failure::errorStatus
           : word == "value"  ? Failure::wrongValue
           : word == "state"  ? Failure::nullState
           : word == "lost"   ? Failure::lostHandle
                              : Failure::nullResult;
}

/// Does what the step says about the stage. \return whether it is such a step
bool setStage(const Step& step, Stage& stage)
{
    const std::string& name = step.name();
    if (name == "node") {
        const std::optional<unsigned int> alarmState =
            step.text(4) ? std::optional<unsigned int>(step.number(4)) : std::nullopt;
        stage.nodes.push_back({step.text(1).value_or(""), step.text(2).value_or(""), step.number(3),
                               alarmState, step.number(0)});
    } else if (name == "clear") {
        stage.nodes.clear();
    } else if (name == "systems") {
        setenv("TAVRO_COMPUTER_SYSTEMS", step.text(0).value_or("").c_str(), 1);
    } else if (name == "broker") {
        stage.broker = step.text(0).value_or("null");
    } else if (name == "context") {
        stage.context = step.text(0).value_or("null");
    } else if (name == "result") {
        stage.result = step.text(0).value_or("null");
    } else if (name == "fail") {
        stage.failingCall = step.number(0);
        stage.failure = failureCalled(step.text(1).value_or(""));
    } else if (name == "exhaust") {
        stage.failingAllocation = step.number(0);
    } else {
        return false;
    }
    return true;
}

cim::ObjectPath pathOf(const std::string& text)
{
    try {
        return cim::parseObjectPath(text);
    } catch (const cim::ParseError&) {
        return {"", "root/cimv2", text, {}};
    }
}

bool isObjectWord(const std::string& text)
{
    return text == "null" || text == "bare" || text == "empty" || text == "lost";
}

/// An operation with all its arguments, ready to be run in requests of its own.
class Operation
{
public:
    Operation(const Step& step, const Stage& stage, const Provider& provider)
        : step_(step),
          stage_(stage),
          provider_(provider)
    {}

    /// Whether all that is handed to the provider is whole.
    [[nodiscard]] bool isSound() const { return stage_.isOwn() && !isObjectWord(target()); }

    /// \return what it answered; an empty answer if the memory ran out
    [[nodiscard]] cim::Answer run() const
    {
        cimhost::Request request(host().broker);
        const CMPIContext* const context = request.context();
        const CMPIResult* const result = request.result();
        CMPIObjectPath* const path =
            request.path(isObjectWord(target()) ? cim::ObjectPath() : pathOf(target()));
        const Handles handles{
            brokerCalled(stage_.broker), objectCalled(stage_.context, const_cast<CMPIContext*>(context)),
            objectCalled(stage_.result, const_cast<CMPIResult*>(result)), objectCalled(target(), path)};
        CMPIStatus status{CMPI_RC_OK, nullptr};
        if (stage_.failingAllocation > 0)
            Allocations::failNth(stage_.failingAllocation);
        try {
            status = call(handles);
        } catch (const std::bad_alloc&) {
            require(Allocations::stop(), "memory runs out only when it is made to");
        }
        Allocations::stop();
        return request.answer(status);
    }

private:
    struct Handles
    {
        const CMPIBroker* broker;
        const CMPIContext* context;
        const CMPIResult* result;
        const CMPIObjectPath* path;
    };

    [[nodiscard]] std::string target() const { return step_.text(1).value_or("null"); }

    [[nodiscard]] CMPIStatus call(const Handles& handles) const
    {
        const bool traverses = !step_.name().empty() && (step_.name()[0] == 'a' || step_.name()[0] == 'r');
        if (step_.name() == "end")
            return end(handles);
        if (!traverses)
            return callInstanceMI(handles);
        return provider_.createAssociationMI != nullptr ? traverse(handles) : CMPIStatus{CMPI_RC_OK, nullptr};
    }

    [[nodiscard]] CMPIStatus callInstanceMI(const Handles& h) const
    {
        const std::string& name = step_.name();
        CMPIInstanceMI* const mi = provider_.createInstanceMI(h.broker, h.context, nullptr);
        const CMPIInstanceMIFT& table = *mi->ft;
        NameList properties(step_.list(2));
        const auto query = step_.text(2);
        const auto language = step_.text(3);
        if (name == "ein")
            return table.enumerateInstanceNames(mi, h.context, h.result, h.path);
        if (name == "ei")
            return table.enumerateInstances(mi, h.context, h.result, h.path, properties.pointer());
        if (name == "gi")
            return table.getInstance(mi, h.context, h.result, h.path, properties.pointer());
        CMPIStatus refused{CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
        if (name == "ci")
            refused = table.createInstance(mi, h.context, h.result, h.path, nullptr);
        else if (name == "mi")
            refused = table.modifyInstance(mi, h.context, h.result, h.path, nullptr, properties.pointer());
        else if (name == "di")
            refused = table.deleteInstance(mi, h.context, h.result, h.path);
        else if (name == "xq")
            refused = table.execQuery(mi, h.context, h.result, h.path, pointerTo(query), pointerTo(language));
        require(refused.rc == CMPI_RC_ERR_NOT_SUPPORTED && refused.msg == nullptr,
                "what would change something is not supported");
        return refused;
    }

    [[nodiscard]] CMPIStatus traverse(const Handles& h) const
    {
        const std::string& name = step_.name();
        CMPIAssociationMI* const mi = provider_.createAssociationMI(h.broker, h.context, nullptr);
        const CMPIAssociationMIFT& table = *mi->ft;
        const std::array<std::optional<std::string>, 4> texts{step_.text(2), step_.text(3), step_.text(4),
                                                              step_.text(5)};
        const auto argument = [&](std::size_t position) { return pointerTo(texts.at(position)); };
        NameList properties(step_.list(name == "ai" ? 6 : 4));
        if (name == "ai")
            return table.associators(mi, h.context, h.result, h.path, argument(0), argument(1), argument(2),
                                     argument(3), properties.pointer());
        if (name == "ain")
            return table.associatorNames(mi, h.context, h.result, h.path, argument(0), argument(1),
                                         argument(2), argument(3));
        if (name == "ri")
            return table.references(mi, h.context, h.result, h.path, argument(0), argument(1),
                                    properties.pointer());
        if (name == "rin")
            return table.referenceNames(mi, h.context, h.result, h.path, argument(0), argument(1));
        return {CMPI_RC_OK, nullptr};
    }

    [[nodiscard]] CMPIStatus end(const Handles& h) const
    {
        const auto terminating = static_cast<CMPIBoolean>(step_.number(1) % 2);
        CMPIInstanceMI* const mi = provider_.createInstanceMI(h.broker, h.context, nullptr);
        CMPIStatus status = mi->ft->cleanup(mi, h.context, terminating);
        require(status.rc == CMPI_RC_OK, "the clean-up succeeds");
        if (provider_.createAssociationMI != nullptr) {
            CMPIAssociationMI* const traversals = provider_.createAssociationMI(h.broker, h.context, nullptr);
            status = traversals->ft->cleanup(traversals, h.context, terminating);
            require(status.rc == CMPI_RC_OK, "the clean-up succeeds");
        }
        return status;
    }

    const Step& step_;
    const Stage& stage_;
    const Provider& provider_;
};

bool sameAnswer(const cim::Answer& a, const cim::Answer& b)
{
    return a.status.code == b.status.code && a.status.message == b.status.message && a.paths == b.paths &&
           a.instances == b.instances;
}

bool beginsWith(const std::string& text, const std::string& beginning)
{
    return text.compare(0, beginning.size(), beginning) == 0;
}

/// Each line was given to the log and then to the trace, and is whole as far as its buffer has room.
void checkLines()
{
    constexpr std::size_t longestLine = 511;
    const std::vector<RecordedLog::Line> lines = RecordedLog::lines();
    require(lines.size() % 2 == 0, "lines come in pairs");
    for (std::size_t i = 0; i + 1 < lines.size(); i += 2) {
        const std::string& text = lines[i].text;
        require(text == lines[i + 1].text, "both lines of a pair are alike");
        require(beginsWith(text, "ENTERING: ") || beginsWith(text, "EXITING: ") ||
                    beginsWith(text, "MESSAGE ["),
                "a line begins with its kind");
        require(text.size() <= longestLine, "a line fits its buffer");
    }
}

void perform(const Step& step, Stage& stage, const Provider& provider)
{
    const Operation operation(step, stage, provider);
    RecordedLog::clear();
    MadeInventory::set(stage.nodes);
    host().misuses = 0;
    if (stage.isWhole()) {
        const cim::Answer answer = operation.run();
        checkLines();
        require(sameAnswer(operation.run(), answer), "the same request brings the same answer");
        require(!operation.isSound() || host().misuses == 0,
                "the provider does nothing wrong with the broker");
    } else {
        RecordingBroker layer(host().broker);
        if (stage.failingCall > 0)
            layer.fail("", static_cast<int>(stage.failingCall % 10000), stage.failure);
        static_cast<void>(operation.run());
        if (stage.failingAllocation == 0)
            checkLines();
    }
    require(MadeInventory::openCursors() == 0, "no cursor stays open");
    stage.failingCall = stage.failingAllocation = 0;
}

} // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    Stage stage;
    for (const Step& step : Fuzz::stepsOf(Fuzz::textOf(data, size))) {
        if (setStage(step, stage))
            continue;
        if (const Provider* const provider = findProvider(step.text(0).value_or("")))
            perform(step, stage, *provider);
    }
    return 0;
}
