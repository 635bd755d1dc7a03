/// \file
/// Function tables of providers, made of operations. Older CMPI headers leave out a `const` here and there:
/// at the operations' arguments, at the tables and at their names; and versions have no type of their own
/// there.
#ifndef TAVRO_GLIMMARK_FUNCTIONTABLES_H
#define TAVRO_GLIMMARK_FUNCTIONTABLES_H

#include <cmpift.h>

#include <type_traits>

namespace Tavro::GlimmarkProvider {

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

} // namespace Tavro::GlimmarkProvider

#endif
