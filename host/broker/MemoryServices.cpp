#include "broker/Call.h"
#include "broker/Tables.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <limits>

namespace cimhost {

namespace {

/// A new block of zeroes that lives as long as the objects that are made now.
void* allocate(Core& core, std::size_t size)
{
    // A block of no bytes has an address of its own, too.
    void* const block = std::calloc(1, std::max(size, std::size_t{1}));
    if (block == nullptr)
        Call::leave(CMPI_RC_ERR_FAILED);
    auto memory = std::make_unique<MemoryObject>(block, size);
    Scope* const scope = Scope::innermost(core);
    if (scope != nullptr) {
        scope->store().addMemory(std::move(memory));
    } else {
        const std::lock_guard<std::mutex> lock(core.lastingMutex);
        core.lasting->addMemory(std::move(memory));
    }
    return block;
}

/// The handle of a block of this thread's scopes, or of a lasting one.
/// \throws Refusal  and reports
/// for any other pointer
Handle& findMemory(Call& call, Core& core, void* block)
{
    Handle* found = nullptr;
    for (Scope* scope = Scope::innermost(core); scope != nullptr && found == nullptr; scope = scope->outer())
        found = scope->store().findMemory(block);
    if (found == nullptr) {
        const std::lock_guard<std::mutex> lock(core.lastingMutex);
        found = core.lasting->findMemory(block);
    }
    if (found == nullptr)
        call.refuse(CMPI_RC_ERR_INVALID_HANDLE, "the memory is not the broker's, or was freed before");
    return *found;
}

/// Runs a service that answers with memory; null when there is none.
template <class Body>
void* serveMemory(const char* service, const CMPIBroker* broker, const Body& body)
{
    return serve(service, nullptr, static_cast<void*>(nullptr),
                 [&](Call& call) { return body(call, call.broker(broker)); });
}

CMPIGcStat* mark(const CMPIBroker* broker, CMPIStatus* rc)
{
    return serve("CMPIBrokerMemFT.mark", rc, static_cast<CMPIGcStat*>(nullptr), [&](Call& call) {
        Scope* const scope = Scope::innermost(call.broker(broker));
        if (scope == nullptr)
            call.refuse(CMPI_RC_ERR_NOT_SUPPORTED, "called outside of any request");
        ObjectStore& store = scope->store();
        Handle& handle = store.add(std::make_unique<MarkObject>(MarkObject{&store, store.count()}));
        return static_cast<CMPIGcStat*>(&handle.envelope);
    });
}

CMPIStatus release(const CMPIBroker* broker, const CMPIGcStat* place)
{
    return perform("CMPIBrokerMemFT.release", [&](Call& call) {
        Core& core = call.broker(broker);
        const MarkObject made = contentOf<MarkObject>(call.resolve(place, "the mark", Kind::mark));
        for (Scope* scope = Scope::innermost(core); scope != nullptr; scope = scope->outer())
            if (&scope->store() == made.store)
                return made.store->releaseFrom(made.ordinal);
        call.refuse(CMPI_RC_ERR_INVALID_HANDLE, "the mark is another thread's");
    });
}

void* allocateBlock(const CMPIBroker* broker, size_t size)
{
    return serveMemory("CMPIBrokerMemFT.cmpiMalloc", broker,
                       [&](Call& /*call*/, Core& core) { return allocate(core, size); });
}

void* allocateElements(const CMPIBroker* broker, size_t count, size_t size)
{
    return serveMemory("CMPIBrokerMemFT.cmpiCalloc", broker, [&](Call& /*call*/, Core& core) {
        if (size != 0 && count > std::numeric_limits<std::size_t>::max() / size)
            Call::leave(CMPI_RC_ERR_FAILED);
        return allocate(core, count * size);
    });
}

void* reallocate(const CMPIBroker* broker, void* block, size_t size)
{
    return serveMemory("CMPIBrokerMemFT.cmpiRealloc", broker, [&](Call& call, Core& core) {
        if (block == nullptr)
            return allocate(core, size);
        Handle& old = findMemory(call, core, block);
        void* const grown = allocate(core, size);
        std::memcpy(grown, block, std::min(size, contentOf<MemoryObject>(old).size));
        end(old, State::released);
        return grown;
    });
}

char* duplicate(const CMPIBroker* broker, const char* text)
{
    return static_cast<char*>(serveMemory("CMPIBrokerMemFT.cmpiStrDup", broker, [&](Call& call, Core& core) {
        const std::size_t size = std::strlen(call.text(text, "the text")) + 1;
        return std::memcpy(allocate(core, size), text, size);
    }));
}

void freeBlock(const CMPIBroker* broker, void* block)
{
    serveMemory("CMPIBrokerMemFT.cmpiFree", broker, [&](Call& call, Core& core) -> void* {
        if (block != nullptr)
            end(findMemory(call, core, block), State::released);
        return nullptr;
    });
}

template <class Object>
void freeObject(const char* service, const CMPIBroker* broker, const EnvelopeOf<Object>* object)
{
    perform(service, [&](Call& call) {
        call.broker(broker);
        end(call.resolve(object, "the object", Traits<Object>::kind), State::released);
    });
}

void freeInstance(const CMPIBroker* broker, CMPIInstance* instance)
{
    freeObject<InstanceObject>("CMPIBrokerMemFT.freeInstance", broker, instance);
}

void freeObjectPath(const CMPIBroker* broker, CMPIObjectPath* path)
{
    freeObject<ObjectPathObject>("CMPIBrokerMemFT.freeObjectPath", broker, path);
}

void freeArgs(const CMPIBroker* broker, CMPIArgs* args)
{
    freeObject<ArgsObject>("CMPIBrokerMemFT.freeArgs", broker, args);
}

void freeString(const CMPIBroker* broker, CMPIString* string)
{
    freeObject<StringObject>("CMPIBrokerMemFT.freeString", broker, string);
}

void freeArray(const CMPIBroker* broker, CMPIArray* array)
{
    freeObject<ArrayObject>("CMPIBrokerMemFT.freeArray", broker, array);
}

void freeDateTime(const CMPIBroker* broker, CMPIDateTime* dateTime)
{
    freeObject<DateTimeObject>("CMPIBrokerMemFT.freeDateTime", broker, dateTime);
}

/// The broker makes no select expression, and so there is none to free.
void freeSelectExp(const CMPIBroker* broker, CMPISelectExp* /*expression*/)
{
    perform("CMPIBrokerMemFT.freeSelectExp", [&](Call& call) {
        call.broker(broker);
        call.refuse(CMPI_RC_ERR_INVALID_HANDLE, "the select expression was not made by this broker");
    });
}

} // namespace

CMPIBrokerMemFT memoryServices()
{
    return {servedVersion, mark,       release,   allocateBlock, allocateElements,
            reallocate,    duplicate,  freeBlock, freeInstance,  freeObjectPath,
            freeArgs,      freeString, freeArray, freeDateTime,  freeSelectExp};
}

} // namespace cimhost
