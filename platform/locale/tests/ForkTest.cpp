// A child that was forked while other threads read texts can read them.

#include <Tavro/Locale.h>

#include "testing/ForkUnderLoad.h"

#include <string>

#include <gtest/gtest.h>

namespace {

TEST(Fork, childrenReadTexts)
{
    if (!Testing::childrenMayAllocate)
        GTEST_SKIP() << "the sanitizer's allocator is not made for it";
    constexpr int children = 300;
    const auto read = [] {
        for (const char* const language : {"en", "de", "zh_Hans_CN"}) {
            const Tavro::ResourceString text(Tavro::Locale::getResourceLibrary(2, language),
                                             L"MSGID_ALARMDEVICE_CAPTION");
            Tavro::make_string(text);
        }
    };
    EXPECT_EQ(Testing::childrenThatReturn(children, read), children);
}

} // namespace
