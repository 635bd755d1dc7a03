/// \file
/// Help for tests of what a user may not do.
#ifndef TESTING_WITHOUTPRIVILEGES_H
#define TESTING_WITHOUTPRIVILEGES_H

#include <gtest/gtest.h>

#include <sys/types.h>
#include <unistd.h>

namespace Testing {

/// Root may read everything; for as long as this lives, the test is somebody who may not.
class WithoutPrivileges
{
public:
    WithoutPrivileges() : before_(geteuid())
    {
        if (before_ == 0) {
            EXPECT_EQ(seteuid(65534), 0);
        }
    }
    ~WithoutPrivileges() { EXPECT_EQ(seteuid(before_), 0); }
    WithoutPrivileges(const WithoutPrivileges&) = delete;
    WithoutPrivileges& operator=(const WithoutPrivileges&) = delete;

private:
    uid_t before_;
};

} // namespace Testing

#endif
