#include "cim/Mof.h"

#include "cim/Values.h"

#include <gtest/gtest.h>

using namespace cimhost::cim;

namespace {

TEST(Mof, showsAnInstanceAfterItsPath)
{
    const Instance instance{{"", "root/cimv2", "CIM_A", {{"K", textValue("x")}}},
                            {{"K", textValue("x")},
                             {"States", arrayValue(CMPI_uint16, {std::uint64_t{2}, std::uint64_t{11}})},
                             {"Gone", nullValue(CMPI_string)}}};
    EXPECT_EQ(mof(instance), "// root/cimv2:CIM_A.K=\"x\"\n"
                             "instance of CIM_A\n"
                             "{\n"
                             "    K = \"x\";\n"
                             "    States = {2, 11};\n"
                             "    Gone = NULL;\n"
                             "};\n");
}

TEST(Mof, showsAPathAsAnInstanceWithItsKeys)
{
    EXPECT_EQ(mof(ObjectPath{"", "", "CIM_A", {{"K", unsignedValue(1)}}}), "// CIM_A.K=1\n"
                                                                           "instance of CIM_A\n"
                                                                           "{\n"
                                                                           "    K = 1;\n"
                                                                           "};\n");
}

TEST(Mof, keepsAHostileTextInsideItsLiteral)
{
    const Instance instance{{"", "", "CIM_A\n", {}}, {{"P\n", textValue("\"; };\ninstance of CIM_B {\x1b")}}};
    EXPECT_EQ(mof(instance), "// CIM_A\\n\n"
                             "instance of CIM_A\\n\n"
                             "{\n"
                             "    P\\n = \"\\\"; };\\ninstance of CIM_B {\\x001B\";\n"
                             "};\n");
}

} // namespace
