#include <Tavro/Common.h>

#include "testing/TemporaryDirectory.h"

#include <string>
#include <type_traits>

#include <gtest/gtest.h>

namespace {

static_assert(std::is_same_v<decltype(Tavro::getSystemName), std::string()>);

TEST(SystemName, isTheKernelsNameOfTheHost)
{
    const std::string kernelsName = Testing::contentOf("/proc/sys/kernel/hostname");
    EXPECT_EQ(Tavro::getSystemName() + '\n', kernelsName);
}

} // namespace
