/// \file
/// Values as providers pass them (CMPIValue with a type) and as the broker keeps them (cim::Value).
#ifndef CIMHOST_BROKER_VALUES_H
#define CIMHOST_BROKER_VALUES_H

#include "broker/Call.h"
#include "broker/Core.h"
#include "cim/Model.h"

#include <cstring>
#include <string>

namespace cimhost {

/// The type as it is kept: CMPI_string for CMPI_chars, the same for their arrays.
CMPIType keptType(CMPIType type);

/// Whether a single value can have the type, CMPI_chars included; an array's elements likewise.
bool isScalarType(CMPIType type);

/// Reads what a provider passed. A null pointer, the type CMPI_null, or a null object in the value is
/// a null value. For CMPI_chars `value` is the character pointer.
/// \param role  what the value is in this call, for the report of misuse
/// \throws Refusal  and reports for a type that has no value in CIM (CMPI_RC_ERR_INVALID_DATA_TYPE), a
/// foreign or dead object (CMPI_RC_ERR_INVALID_HANDLE), an array of another type (CMPI_RC_ERR_TYPE_MISMATCH)
cim::Value takeValue(Call& call, const CMPIValue* value, CMPIType type, const char* role);

/// The same for one element, of a type without CMPI_ARRAY.
cim::Value::Scalar takeScalar(Call& call, const CMPIValue* value, CMPIType type, const char* role);

/// What a provider gets to see; text, references, arrays and the like as new objects of this thread's
/// request.
/// \param state  flags to be set besides CMPI_nullValue
CMPIData giveValue(Core& core, const cim::Value& value, CMPIValueState state = CMPI_goodValue);

/// The same for one element.
CMPIData giveScalar(Core& core, const cim::Value::Scalar& scalar, CMPIType type);

/// Data of a type without a value: no bit of it is set. Braces would set the union's first member alone, and
/// leave a pointer of the other bits to whoever takes data for what its type says.
inline CMPIData emptyData(CMPIType type, CMPIValueState state)
{
    CMPIData data;
    std::memset(&data, 0, sizeof data);
    data.type = type;
    data.state = state;
    return data;
}

/// The data of something that is not there.
inline CMPIData noData(CMPIValueState state = CMPI_notFound)
{
    return emptyData(CMPI_null, state);
}

} // namespace cimhost

#endif
