#pragma once
// Host tests against a CUPS scheduler of the test's own, reached through
// CUPS_SERVER as any client would. Derived fixtures add their queues after
// calling SetUp (and return when it skipped or failed).
#include <memory>

#include "HostTestSupport.h"
#include "PrivateCupsd.h"

namespace host_test
{
class HostWithScheduler : public HostTest
{
protected:
    void SetUp() override
    {
        HostTest::SetUp();
        if (!cups_test::PrivateCupsd::Installed())
            GTEST_SKIP() << "cupsd or lpadmin missing (packages cups-daemon, cups-client)";
        // The queue's filters run as the print user and must reach the spool
        // and the device files below the scratch directory.
        ASSERT_EQ(chmod(scratch.c_str(), 0755), 0);
        const std::string root = scratch + "/cups";
        ASSERT_EQ(mkdir(root.c_str(), 0755), 0);
        scheduler = std::make_unique<cups_test::PrivateCupsd>(root);
        std::string problem;
        ASSERT_TRUE(scheduler->Start(problem)) << problem;
        setenv("CUPS_SERVER", scheduler->Server().c_str(), 1);
    }
    void TearDown() override
    {
        unsetenv("CUPS_SERVER");
        scheduler.reset();
        HostTest::TearDown();
    }
    bool Ready() const { return scheduler && !IsSkipped() && !HasFailure(); }

    std::unique_ptr<cups_test::PrivateCupsd> scheduler;
};
} // namespace host_test
