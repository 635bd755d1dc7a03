/// \file
/// What the four providers share: fixed answers, function table entries, and the walks over result lists.
#ifndef TAVRO_GLIMMARK_PROVIDERFRAME_H
#define TAVRO_GLIMMARK_PROVIDERFRAME_H

#include "Cmpi.h"
#include "GlimmarkFactory.h"
#include "RequestPaths.h"

#include <atomic>
#include <cstdint>
#include <type_traits>
#include <vector>

namespace Tavro::GlimmarkProvider {

/// A module's broker: written by the module's MI factory functions and read by its operations, on any
/// thread. Null until a broker has loaded the provider.
using BrokerPointer = std::atomic<const CMPIBroker*>;

// Statuses.

inline CMPIStatus okStatus()
{
    return {CMPI_RC_OK, nullptr};
}

/// The answer to all that would change something: the library only reads.
inline CMPIStatus notSupportedStatus()
{
    return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
}

// Function tables. Older CMPI headers leave out a `const` here and there: at the operations' arguments, at
// the tables and at their names; and versions have no type of their own there.

constexpr int interfaceVersion = 200;

/// The function table that an MI record points to.
template <class MI>
using FunctionTable = std::remove_pointer_t<decltype(MI::ft)>;

template <class Type>
struct WithoutConst
{
    using type = std::remove_const_t<Type>;
};
template <class Type>
struct WithoutConst<Type*>
{
    using type = typename WithoutConst<std::remove_const_t<Type>>::type*;
};

template <class... Arguments>
using OperationPointer = CMPIStatus (*)(Arguments...);

/// An operation on its way into a slot of a function table, whose arguments may differ in `const` only.
template <class... Arguments>
class Entry
{
public:
    constexpr explicit Entry(OperationPointer<Arguments...> entry) : operation(entry) {}

    template <class... Parameters>
    constexpr operator OperationPointer<Parameters...>() const
    {
        static_assert(std::is_same_v<OperationPointer<typename WithoutConst<Arguments>::type...>,
                                     OperationPointer<typename WithoutConst<Parameters>::type...>>,
                      "the operation does not fit the slot");
        if constexpr (std::is_same_v<OperationPointer<Arguments...>, OperationPointer<Parameters...>>)
            return operation;
        else
            return reinterpret_cast<OperationPointer<Parameters...>>(operation);
    }

private:
    OperationPointer<Arguments...> operation;
};

/// The name of an MI as the function tables take it.
constexpr char* miName(const char* name)
{
    return const_cast<char*>(name);
}

// Result lists. They are counted and walked with 16 bits, and each access is checked.

template <class Item>
std::uint16_t countOf(const std::vector<Item*>& list)
{
    return static_cast<std::uint16_t>(list.size());
}

/// Calls `visit` with each item.
template <class Item, class Visit>
void forEach(const std::vector<Item*>& list, Visit visit)
{
    const std::uint16_t count = countOf(list);
    for (std::uint16_t i = 0; i < count; ++i)
        visit(list.at(i));
}

/// Reserves a place for each indicator of the factory, as far as 16 bits count them.
template <class Item>
void reserveFor(const GlimmarkFactory& factory, std::vector<Item*>& list)
{
    list.reserve(static_cast<std::uint16_t>(factory.getNumberOfInstances()));
}

/// Returns each instance as it is, null ones too.
inline void returnInstances(const CMPIResult* result, const std::vector<CMPIInstance*>& instances)
{
    forEach(instances, [&](const CMPIInstance* instance) { Cmpi::returnInstance(result, instance); });
}

/// Puts a path into the namespace of the request's path and returns it.
inline void returnObjectPathOf(const CMPIResult* result, const CMPIObjectPath* path,
                               const CMPIObjectPath* ref, CMPIStatus* rc)
{
    setNameSpaceOf(path, ref, rc);
    Cmpi::returnObjectPath(result, path);
}

/// Whether the request's path has a key. If not, reports the failure.
inline bool requireKeys(const CMPIBroker* broker, const char* provider, const CMPIObjectPath* cop,
                        CMPIStatus& status)
{
    if (Cmpi::keyCountOf(cop, &status) != 0)
        return true;
    const char* const text = "At least one key should be passed";
    Cmpi::reportFailure(broker, provider, &status, text, text);
    return false;
}

/// Whether an instance has the path that was asked for. \param deep  compares references among the keys as
/// paths. An instance without an object behind it equals nothing.
inline bool isAt(const CMPIInstance* instance, const CMPIObjectPath* cop, bool deep, CMPIStatus& status)
{
    return Cmpi::exists(instance) && isObjPathsEqual(cop, Cmpi::objectPathOf(instance, &status), deep);
}

/// Returns the first of the instances that has the path asked for, if there is one.
inline void returnFirstAt(const CMPIResult* result, const std::vector<CMPIInstance*>& instances,
                          const CMPIObjectPath* cop, bool deep, CMPIStatus& status)
{
    const std::uint16_t count = countOf(instances);
    for (std::uint16_t i = 0; i < count; ++i) {
        if (isAt(instances.at(i), cop, deep, status)) {
            Cmpi::returnInstance(result, instances.at(i));
            return;
        }
    }
}

} // namespace Tavro::GlimmarkProvider

#endif
