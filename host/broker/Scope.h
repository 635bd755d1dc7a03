/// \file
/// Which request the objects made on a thread belong to.
#ifndef CIMHOST_BROKER_SCOPE_H
#define CIMHOST_BROKER_SCOPE_H

#include "broker/Core.h"
#include "broker/Names.h"
#include "broker/ObjectStore.h"
#include "broker/Objects.h"

#include <memory>
#include <mutex>
#include <utility>

namespace cimhost {

/// The objects that a thread makes belong to its innermost Scope of their broker. Scopes of a thread
/// end in the reverse order of their making, on the same thread. Ending one does not touch the broker.
class Scope
{
public:
    explicit Scope(Core& core);
    ~Scope();
    Scope(const Scope&) = delete;
    Scope& operator=(const Scope&) = delete;

    ObjectStore& store() { return store_; }
    /// The names of a list that ends with a null pointer. Instances of a request have the same filter, mostly.
    std::shared_ptr<const NameSet> filterOf(const char* const* names);
    /// The next scope around this one for the same broker; null when there is none.
    [[nodiscard]] Scope* outer() const;
    /// How many scopes of any broker this one is nested in.
    [[nodiscard]] int depth() const { return depth_; }

    /// The innermost scope of this thread for that broker; null when there is none.
    static Scope* innermost(const Core& core);
    /// The broker of this thread's innermost scope; null when there is none.
    static Core* currentCore();

private:
    friend class OutsideScopes;

    /// The first scope of that broker, from `scope` outwards.
    static Scope* firstOf(const Core& core, Scope* scope);

    Core& core_;
    Scope* outer_;
    int depth_;
    ObjectStore store_;
    std::shared_ptr<const NameSet> lastFilter_; ///< null: there was none
};

/// While it exists, its thread is in no scope: what is made then lasts as long as the broker.
class OutsideScopes
{
public:
    OutsideScopes();
    ~OutsideScopes();
    OutsideScopes(const OutsideScopes&) = delete;
    OutsideScopes& operator=(const OutsideScopes&) = delete;

private:
    Scope* suspended_;
};

/// A new object that lasts as long as the broker, or until it is released.
template <class Object>
Handle& makeLasting(Core& core, std::unique_ptr<Object> content)
{
    const std::lock_guard<std::mutex> lock(core.lastingMutex);
    return core.lasting->add(std::move(content));
}

/// A new object in this thread's scope; lasting when it has none.
template <class Object>
Handle& makeObject(Core& core, std::unique_ptr<Object> content)
{
    Scope* const scope = Scope::innermost(core);
    return scope != nullptr ? scope->store().add(std::move(content)) : makeLasting(core, std::move(content));
}

/// The names of a list that ends with a null pointer, shared within this thread's scope where they are the same as
/// those before.
std::shared_ptr<const NameSet> filterOf(Core& core, const char* const* names);

/// The envelope of an object of that kind.
template <class Object>
EnvelopeOf<Object>* envelopeOf(Handle& handle)
{
    return &(handle.envelope.*(Traits<Object>::envelope));
}

/// A new object's envelope, its content made of the arguments.
template <class Object, class... Arguments>
EnvelopeOf<Object>* make(Core& core, Arguments&&... arguments)
{
    return envelopeOf<Object>(
        makeObject(core, std::unique_ptr<Object>(new Object{std::forward<Arguments>(arguments)...})));
}

} // namespace cimhost

#endif
