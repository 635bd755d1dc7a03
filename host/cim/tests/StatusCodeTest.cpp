#include "cim/StatusCode.h"

#include <gtest/gtest.h>

using cimhost::cim::statusName;

namespace {

TEST(StatusNames, areThoseOfTheInterface)
{
    EXPECT_EQ(statusName(CMPI_RC_OK), "CMPI_RC_OK");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(1)), "CMPI_RC_ERR_FAILED");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(2)), "CMPI_RC_ERR_ACCESS_DENIED");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(3)), "CMPI_RC_ERR_INVALID_NAMESPACE");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(4)), "CMPI_RC_ERR_INVALID_PARAMETER");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(5)), "CMPI_RC_ERR_INVALID_CLASS");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(6)), "CMPI_RC_ERR_NOT_FOUND");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(7)), "CMPI_RC_ERR_NOT_SUPPORTED");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(8)), "CMPI_RC_ERR_CLASS_HAS_CHILDREN");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(9)), "CMPI_RC_ERR_CLASS_HAS_INSTANCES");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(10)), "CMPI_RC_ERR_INVALID_SUPERCLASS");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(11)), "CMPI_RC_ERR_ALREADY_EXISTS");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(12)), "CMPI_RC_ERR_NO_SUCH_PROPERTY");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(13)), "CMPI_RC_ERR_TYPE_MISMATCH");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(14)), "CMPI_RC_ERR_QUERY_LANGUAGE_NOT_SUPPORTED");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(15)), "CMPI_RC_ERR_INVALID_QUERY");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(16)), "CMPI_RC_ERR_METHOD_NOT_AVAILABLE");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(17)), "CMPI_RC_ERR_METHOD_NOT_FOUND");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(50)), "CMPI_RC_DO_NOT_UNLOAD");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(51)), "CMPI_RC_NEVER_UNLOAD");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(60)), "CMPI_RC_ERR_INVALID_HANDLE");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(61)), "CMPI_RC_ERR_INVALID_DATA_TYPE");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(100)), "CMPI_RC_ERROR_SYSTEM");
    EXPECT_EQ(statusName(static_cast<CMPIrc>(200)), "CMPI_RC_ERROR");
}

TEST(StatusNames, areMissingForOtherNumbers)
{
    EXPECT_EQ(statusName(static_cast<CMPIrc>(99)), "unknown status code");
}

} // namespace
