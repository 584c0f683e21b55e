// Submission to a real CUPS scheduler started by the test: the job gets
// its name and paper, and the PostScript reaches the queue's device file.
#include <chrono>
#include <thread>

#include <cups/cups.h>
#include <gtest/gtest.h>

#include "CupsSubmission.h"
#include "PpdSources.h"
#include "PrivateCupsd.h"
#include "SampleEps.h"
#include "TestKit.h"

using printing::SubmitToCups;

namespace
{
const char* const kQueue = "hotfolder_test";
const char* const kFilter = "/usr/lib/cups/filter/pstops";

struct Job
{
    int state = 0;
    std::string name;
    std::string pageSize;
};

class CupsSubmission : public ::testing::Test
{
protected:
    void SetUp() override
    {
        if (!cups_test::PrivateCupsd::Installed())
            GTEST_SKIP() << "cupsd or lpadmin missing (packages cups-daemon, cups-client)";
        if (access(kFilter, X_OK) != 0)
            GTEST_SKIP() << kFilter << " missing (package cups-core-drivers)";
        scheduler = std::make_unique<cups_test::PrivateCupsd>(scratch.Path());
        std::string problem;
        ASSERT_TRUE(scheduler->Start(problem)) << problem;
        device = scratch.File("device.ps");
        ASSERT_TRUE(scheduler->AddFileQueue(kQueue, ppd_sources::TestPpd(), device, problem))
            << problem;
        cupsSetServer(scheduler->Server().c_str());
    }
    void TearDown() override
    {
        cupsSetServer(nullptr);
        scheduler.reset();
    }

    std::string Artwork(const std::string& name, const std::string& marker)
    {
        const std::string path = scratch.File(name);
        testkit::WriteFile(path, "%!PS-Adobe-3.0\n%%BoundingBox: 0 0 72 72\n%%Pages: 1\n"
                                 "%%EndComments\n%%Page: 1 1\n(" +
                                     marker +
                                     ") pop\nnewpath 0 0 moveto 72 72 lineto stroke\n"
                                     "showpage\n%%EOF\n");
        return path;
    }

    static Job Attributes(int id)
    {
        ipp_t* request = ippNewRequest(IPP_OP_GET_JOB_ATTRIBUTES);
        const std::string uri = "ipp://localhost/jobs/" + std::to_string(id);
        ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_URI, "job-uri", nullptr, uri.c_str());
        ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_NAME, "requesting-user-name", nullptr,
                     cupsUser());
        Job job;
        ipp_t* response = cupsDoRequest(CUPS_HTTP_DEFAULT, request, "/");
        if (!response)
            return job;
        if (ipp_attribute_t* a = ippFindAttribute(response, "job-state", IPP_TAG_ENUM))
            job.state = ippGetInteger(a, 0);
        if (ipp_attribute_t* a = ippFindAttribute(response, "job-name", IPP_TAG_ZERO))
            job.name = ippGetString(a, 0, nullptr);
        if (ipp_attribute_t* a = ippFindAttribute(response, "PageSize", IPP_TAG_ZERO))
            job.pageSize = ippGetString(a, 0, nullptr);
        ippDelete(response);
        return job;
    }

    // The job once it has left the queue, one way or another.
    Job Finished(int id)
    {
        Job job;
        for (int i = 0; i < 600; ++i)
        {
            job = Attributes(id);
            if (job.state >= IPP_JSTATE_CANCELED)
                break;
            std::this_thread::sleep_for(std::chrono::milliseconds(100));
        }
        return job;
    }

    int JobsOnQueue()
    {
        cups_job_t* jobs = nullptr;
        const int count = cupsGetJobs2(CUPS_HTTP_DEFAULT, &jobs, kQueue, 0, CUPS_WHICHJOBS_ALL);
        cupsFreeJobs(count, jobs);
        return count;
    }

    testkit::ScratchDir scratch;
    std::unique_ptr<cups_test::PrivateCupsd> scheduler;
    std::string device;
};
} // namespace

TEST_F(CupsSubmission, PaperAndNameTravelWithTheJob)
{
    const std::string ps = Artwork("artwork.ps", "hf-marker-paper");
    std::string error;
    int id = 0;
    ASSERT_TRUE(SubmitToCups(kQueue, ps, "artwork.eps", {{"PageSize", "Letter"}}, error, &id))
        << error;
    EXPECT_GT(id, 0);
    const Job job = Finished(id);
    ASSERT_EQ(job.state, IPP_JSTATE_COMPLETED) << scheduler->Log();
    EXPECT_EQ(job.name, "artwork.eps");
    EXPECT_EQ(job.pageSize, "Letter");
    const std::string printed = testkit::ReadFile(device);
    EXPECT_NE(printed.find("hf-marker-paper"), std::string::npos) << printed;
    // The queue's filter selected Letter, not the queue's default A4.
    EXPECT_NE(printed.find("%%BeginFeature: *PageSize Letter\n"
                           "<</PageSize[612 792]/ImagingBBox null>>setpagedevice"),
              std::string::npos)
        << printed;
}

TEST_F(CupsSubmission, CustomSizeAsCustomPaperAndFileNameAsDefaultTitle)
{
    const std::string ps = Artwork("poster.ps", "hf-marker-custom");
    std::string error;
    int id = 0;
    ASSERT_TRUE(SubmitToCups(kQueue, ps, "",
                             {{"PageSize", "Custom"}, {"CustomPageSize", "300.000000 400.000000"}},
                             error, &id))
        << error;
    const Job job = Finished(id);
    ASSERT_EQ(job.state, IPP_JSTATE_COMPLETED) << scheduler->Log();
    EXPECT_EQ(job.name, "poster.ps");
    EXPECT_EQ(job.pageSize, "Custom.300x400");
    const std::string printed = testkit::ReadFile(device);
    EXPECT_NE(printed.find("hf-marker-custom"), std::string::npos);
    // The PPD's custom size code, fed the width and height in points.
    EXPECT_NE(printed.find("%%BeginFeature: *CustomPageSize True\n300\n400\n"), std::string::npos)
        << printed;
}

TEST_F(CupsSubmission, FailuresSayWhyAndLeaveNoJob)
{
    const std::string ps = Artwork("a.ps", "hf-marker-fail");
    std::string error;
    EXPECT_FALSE(SubmitToCups("no_such_queue", ps, "a", {}, error));
    EXPECT_NE(error.find("no_such_queue"), std::string::npos) << error;

    error.clear();
    EXPECT_FALSE(SubmitToCups(kQueue, scratch.File("missing.ps"), "m", {}, error));
    EXPECT_NE(error.find("missing.ps"), std::string::npos) << error;
    EXPECT_EQ(JobsOnQueue(), 0);

    // A scheduler that is gone.
    scheduler->Stop();
    error.clear();
    EXPECT_FALSE(SubmitToCups(kQueue, ps, "a", {{"PageSize", "A4"}}, error));
    EXPECT_GT(error.size(), std::string("cannot create a job on ").size() + 15) << error;
}
