/// \file
/// What stands behind every object that a provider sees: an envelope with its function table, and
/// where the object's content is. A handle outlives its object, so that a pointer to a dead object
/// can be told from one to a living object without touching freed memory.
#ifndef CIMHOST_BROKER_HANDLE_H
#define CIMHOST_BROKER_HANDLE_H

#include <atomic>
#include <cstdint>

#include <cmpift.h>

namespace cimhost {

struct Core;

enum class Kind : std::uint8_t
{
    objectPath,
    instance,
    string,
    array,
    enumeration,
    context,
    result,
    args,
    dateTime,
    error,
    mark,  ///< of the memory services; has no envelope of its own
    memory ///< a block of the memory services; has no envelope of its own
};

enum class State : std::uint8_t
{
    unused,   ///< nothing stood here yet
    live,     ///< the object exists
    released, ///< somebody released it before its time
    ended     ///< its request, or its broker, has ended
};

/// Memory for handles comes from the HandleSpace; a handle never moves.
struct Handle
{
    /// What the provider has a pointer to. Each member is a handle and a function table; `hdl` points
    /// to this very Handle.
    union Envelope
    {
        CMPIObjectPath objectPath;
        CMPIInstance instance;
        CMPIString string;
        CMPIArray array;
        CMPIEnumeration enumeration;
        CMPIContext context;
        CMPIResult result;
        CMPIArgs args;
        CMPIDateTime dateTime;
        CMPIError error;
    };

    Envelope envelope{};
    void* payload = nullptr; ///< the object's content, of the type that belongs to its kind; null when dead
    Core* core = nullptr;    ///< the broker that made the object; only to be followed while it is live
    Kind kind = Kind::string;
    std::atomic<State> state{State::unused};
};

/// Ends a live object: frees its content and leaves it in the state `to`. False when it was not live;
/// of several threads only one succeeds.
bool end(Handle& handle, State to) noexcept;

} // namespace cimhost

#endif
