#include "broker/Values.h"
#include "cim/Values.h"

#include <type_traits>

namespace cimhost {

namespace {

using Scalar = cim::Value::Scalar;

template <class Object>
Scalar takeText(Call& call, const EnvelopeOf<Object>* object, const char* role)
{
    return object == nullptr ? Scalar() : Scalar(call.use<Object>(object, role).text);
}

Scalar takeReference(Call& call, const CMPIObjectPath* path, const char* role)
{
    return path == nullptr ? Scalar() : Scalar(call.use<ObjectPathObject>(path, role).path.share());
}

Scalar takeInstance(Call& call, const CMPIInstance* instance, const char* role)
{
    return instance == nullptr ? Scalar() : Scalar(completed(call.use<InstanceObject>(instance, role)));
}

Scalar takeChars(const CMPIValue* value)
{
    return std::string(reinterpret_cast<const char*>(value));
}

void requireType(Call& call, CMPIType type, const char* role)
{
    if (!isScalarType(type))
        call.refuse(CMPI_RC_ERR_INVALID_DATA_TYPE,
                    std::string(role) + " has the type " + cim::typeName(type) + ", which no CIM value has");
}

cim::Value takeArray(Call& call, const CMPIValue* value, CMPIType type, const char* role)
{
    cim::Value taken{type, true, {}};
    if (value == nullptr || value->array == nullptr)
        return taken;
    const ArrayObject& array = call.use<ArrayObject>(value->array, role);
    if ((array.elementType | CMPI_ARRAY) != type)
        call.refuse(CMPI_RC_ERR_TYPE_MISMATCH, std::string(role) + " is an array of the type " +
                                                   cim::typeName(array.elementType) + ", passed as type " +
                                                   cim::typeName(type));
    taken.isNull = false;
    taken.items = array.elements;
    return taken;
}

template <class Number>
Number numberIn(const Scalar& scalar)
{
    return std::visit(
        [](const auto& held) -> Number {
            if constexpr (std::is_arithmetic_v<std::decay_t<decltype(held)>>)
                return static_cast<Number>(held);
            else
                return Number{};
        },
        scalar);
}

std::string textIn(const Scalar& scalar)
{
    const auto* const text = std::get_if<std::string>(&scalar);
    return text == nullptr ? std::string() : *text;
}

template <class Object, class Content>
EnvelopeOf<Object>* giveShared(Core& core, const Scalar& scalar)
{
    const auto* const held = std::get_if<std::shared_ptr<const Content>>(&scalar);
    if (held == nullptr || *held == nullptr)
        return nullptr;
    return make<Object>(core, Object{cim::CopyOnWrite<Content>(*held)});
}

CMPIInstance* giveInstance(Core& core, const Scalar& scalar)
{
    const auto* const held = std::get_if<std::shared_ptr<const cim::Instance>>(&scalar);
    return held == nullptr || *held == nullptr ? nullptr : make<InstanceObject>(core, *held);
}

} // namespace

bool isScalarType(CMPIType type)
{
    switch (type) {
    case CMPI_boolean:
    case CMPI_char16:
    case CMPI_real32:
    case CMPI_real64:
    case CMPI_uint8:
    case CMPI_uint16:
    case CMPI_uint32:
    case CMPI_uint64:
    case CMPI_sint8:
    case CMPI_sint16:
    case CMPI_sint32:
    case CMPI_sint64:
    case CMPI_string:
    case CMPI_chars:
    case CMPI_dateTime:
    case CMPI_ref:
    case CMPI_instance:
        return true;
    default:
        return false;
    }
}

CMPIType keptType(CMPIType type)
{
    const auto array = static_cast<CMPIType>(type & CMPI_ARRAY);
    const auto element = static_cast<CMPIType>(type & ~CMPI_ARRAY);
    return element == CMPI_chars ? static_cast<CMPIType>(CMPI_string | array) : type;
}

Scalar takeScalar(Call& call, const CMPIValue* value, CMPIType type, const char* role)
{
    if (type == CMPI_null)
        return {};
    requireType(call, type, role);
    if (value == nullptr)
        return {};
    switch (type) {
    case CMPI_boolean:
        return value->boolean != 0;
    case CMPI_char16:
        return std::uint64_t{value->char16};
    case CMPI_real32:
        return static_cast<double>(value->real32);
    case CMPI_real64:
        return value->real64;
    case CMPI_uint8:
        return std::uint64_t{value->uint8};
    case CMPI_uint16:
        return std::uint64_t{value->uint16};
    case CMPI_uint32:
        return std::uint64_t{value->uint32};
    case CMPI_uint64:
        return std::uint64_t{value->uint64};
    case CMPI_sint8:
        return std::int64_t{value->sint8};
    case CMPI_sint16:
        return std::int64_t{value->sint16};
    case CMPI_sint32:
        return std::int64_t{value->sint32};
    case CMPI_sint64:
        return std::int64_t{value->sint64};
    case CMPI_string:
        return takeText<StringObject>(call, value->string, role);
    case CMPI_dateTime:
        return takeText<DateTimeObject>(call, value->dateTime, role);
    case CMPI_ref:
        return takeReference(call, value->ref, role);
    case CMPI_instance:
        return takeInstance(call, value->inst, role);
    default: // CMPI_chars
        return takeChars(value);
    }
}

cim::Value takeValue(Call& call, const CMPIValue* value, CMPIType type, const char* role)
{
    const CMPIType kept = keptType(type);
    if ((type & CMPI_ARRAY) != 0) {
        requireType(call, static_cast<CMPIType>(type & ~CMPI_ARRAY), role);
        return takeArray(call, value, kept, role);
    }
    Scalar scalar = takeScalar(call, value, type, role);
    cim::Value taken{kept, std::holds_alternative<std::monostate>(scalar), {}};
    if (!taken.isNull)
        taken.items.push_back(std::move(scalar));
    return taken;
}

CMPIData giveScalar(Core& core, const Scalar& scalar, CMPIType type)
{
    CMPIData data = emptyData(type, CMPI_goodValue);
    if (std::holds_alternative<std::monostate>(scalar)) {
        data.state = CMPI_nullValue;
        return data;
    }
    switch (type) {
    case CMPI_boolean:
        data.value.boolean = numberIn<bool>(scalar) ? 1 : 0;
        break;
    case CMPI_char16:
        data.value.char16 = numberIn<CMPIChar16>(scalar);
        break;
    case CMPI_real32:
        data.value.real32 = numberIn<CMPIReal32>(scalar);
        break;
    case CMPI_real64:
        data.value.real64 = numberIn<CMPIReal64>(scalar);
        break;
    case CMPI_uint8:
        data.value.uint8 = numberIn<CMPIUint8>(scalar);
        break;
    case CMPI_uint16:
        data.value.uint16 = numberIn<CMPIUint16>(scalar);
        break;
    case CMPI_uint32:
        data.value.uint32 = numberIn<CMPIUint32>(scalar);
        break;
    case CMPI_uint64:
        data.value.uint64 = numberIn<CMPIUint64>(scalar);
        break;
    case CMPI_sint8:
        data.value.sint8 = numberIn<CMPISint8>(scalar);
        break;
    case CMPI_sint16:
        data.value.sint16 = numberIn<CMPISint16>(scalar);
        break;
    case CMPI_sint32:
        data.value.sint32 = numberIn<CMPISint32>(scalar);
        break;
    case CMPI_sint64:
        data.value.sint64 = numberIn<CMPISint64>(scalar);
        break;
    case CMPI_string:
        data.value.string = make<StringObject>(core, textIn(scalar));
        break;
    case CMPI_dateTime:
        data.value.dateTime = make<DateTimeObject>(core, textIn(scalar));
        break;
    case CMPI_ref:
        data.value.ref = giveShared<ObjectPathObject, cim::ObjectPath>(core, scalar);
        break;
    case CMPI_instance:
        data.value.inst = giveInstance(core, scalar);
        break;
    default:
        data.state = CMPI_badValue;
        break;
    }
    return data;
}

CMPIData giveValue(Core& core, const cim::Value& value, CMPIValueState state)
{
    CMPIData data = emptyData(value.type, CMPI_nullValue);
    if (!value.isNull && (value.type & CMPI_ARRAY) != 0) {
        data.state = CMPI_goodValue;
        data.value.array =
            make<ArrayObject>(core, static_cast<CMPIType>(value.type & ~CMPI_ARRAY), value.items);
    } else if (!value.isNull && !value.items.empty()) {
        data = giveScalar(core, value.items.front(), value.type);
    }
    data.state = static_cast<CMPIValueState>(data.state | state);
    return data;
}

} // namespace cimhost
