#include "cim/StatusCode.h"

#include <algorithm>
#include <array>

namespace cimhost::cim {

namespace {

struct StatusName
{
    CMPIrc code;
    const char* name;
};

constexpr std::array statusNames{
    StatusName{CMPI_RC_OK, "CMPI_RC_OK"},
    StatusName{CMPI_RC_ERR_FAILED, "CMPI_RC_ERR_FAILED"},
    StatusName{CMPI_RC_ERR_ACCESS_DENIED, "CMPI_RC_ERR_ACCESS_DENIED"},
    StatusName{CMPI_RC_ERR_INVALID_NAMESPACE, "CMPI_RC_ERR_INVALID_NAMESPACE"},
    StatusName{CMPI_RC_ERR_INVALID_PARAMETER, "CMPI_RC_ERR_INVALID_PARAMETER"},
    StatusName{CMPI_RC_ERR_INVALID_CLASS, "CMPI_RC_ERR_INVALID_CLASS"},
    StatusName{CMPI_RC_ERR_NOT_FOUND, "CMPI_RC_ERR_NOT_FOUND"},
    StatusName{CMPI_RC_ERR_NOT_SUPPORTED, "CMPI_RC_ERR_NOT_SUPPORTED"},
    StatusName{CMPI_RC_ERR_CLASS_HAS_CHILDREN, "CMPI_RC_ERR_CLASS_HAS_CHILDREN"},
    StatusName{CMPI_RC_ERR_CLASS_HAS_INSTANCES, "CMPI_RC_ERR_CLASS_HAS_INSTANCES"},
    StatusName{CMPI_RC_ERR_INVALID_SUPERCLASS, "CMPI_RC_ERR_INVALID_SUPERCLASS"},
    StatusName{CMPI_RC_ERR_ALREADY_EXISTS, "CMPI_RC_ERR_ALREADY_EXISTS"},
    StatusName{CMPI_RC_ERR_NO_SUCH_PROPERTY, "CMPI_RC_ERR_NO_SUCH_PROPERTY"},
    StatusName{CMPI_RC_ERR_TYPE_MISMATCH, "CMPI_RC_ERR_TYPE_MISMATCH"},
    StatusName{CMPI_RC_ERR_QUERY_LANGUAGE_NOT_SUPPORTED, "CMPI_RC_ERR_QUERY_LANGUAGE_NOT_SUPPORTED"},
    StatusName{CMPI_RC_ERR_INVALID_QUERY, "CMPI_RC_ERR_INVALID_QUERY"},
    StatusName{CMPI_RC_ERR_METHOD_NOT_AVAILABLE, "CMPI_RC_ERR_METHOD_NOT_AVAILABLE"},
    StatusName{CMPI_RC_ERR_METHOD_NOT_FOUND, "CMPI_RC_ERR_METHOD_NOT_FOUND"},
    StatusName{CMPI_RC_DO_NOT_UNLOAD, "CMPI_RC_DO_NOT_UNLOAD"},
    StatusName{CMPI_RC_NEVER_UNLOAD, "CMPI_RC_NEVER_UNLOAD"},
    StatusName{CMPI_RC_ERR_INVALID_HANDLE, "CMPI_RC_ERR_INVALID_HANDLE"},
    StatusName{CMPI_RC_ERR_INVALID_DATA_TYPE, "CMPI_RC_ERR_INVALID_DATA_TYPE"},
    StatusName{CMPI_RC_ERROR_SYSTEM, "CMPI_RC_ERROR_SYSTEM"},
    StatusName{CMPI_RC_ERROR, "CMPI_RC_ERROR"},
};

} // namespace

std::string statusName(CMPIrc code)
{
    const auto* found = std::find_if(statusNames.begin(), statusNames.end(),
                                     [&](const StatusName& entry) { return entry.code == code; });
    return found == statusNames.end() ? "unknown status code" : found->name;
}

} // namespace cimhost::cim
