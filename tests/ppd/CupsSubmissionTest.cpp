// Submission to a real CUPS scheduler started by the test: the job gets
// its name and paper, and the PostScript reaches the queue's device file
// through the queue's own filter.
#include <chrono>
#include <memory>
#include <thread>

#include <cups/cups.h>
#include <gtest/gtest.h>

#include "CupsJobOptions.h"
#include "CupsSubmission.h"
#include "PpdCases.h"
#include "PrivateCupsd.h"

using printing::SubmitToCups;

namespace
{
const char* const kQueue = "hotfolder_test";

struct Job
{
    int state = 0;
    std::string name, pageSize;
};

class CupsSubmission : public ::testing::Test
{
protected:
    void SetUp() override
    {
        if (!cups_test::PrivateCupsd::Installed())
            GTEST_SKIP() << cups_test::PrivateCupsd::kMissing;
        scheduler = std::make_unique<cups_test::PrivateCupsd>(scratch.Path());
        std::string problem;
        ASSERT_TRUE(scheduler->Start(problem)) << problem;
        ASSERT_TRUE(scheduler->AddFileQueue(kQueue, ppd_cases::TestPpd(), device, problem))
            << problem;
        cupsSetServer(scheduler->Server().c_str());
        testkit::WriteFile(artwork, "%!PS-Adobe-3.0\n%%BoundingBox: 0 0 72 72\n%%Pages: 1\n"
                                    "%%EndComments\n%%Page: 1 1\n(hf-marker) pop\n"
                                    "newpath 0 0 moveto 72 72 lineto stroke\nshowpage\n%%EOF\n");
    }
    void TearDown() override { cupsSetServer(nullptr); }

    // The job once it has left the queue, one way or another.
    static Job Finished(int id)
    {
        Job job;
        const std::string uri = "ipp://localhost/jobs/" + std::to_string(id);
        for (int i = 0; i < 600 && job.state < IPP_JSTATE_CANCELED; ++i)
        {
            std::this_thread::sleep_for(std::chrono::milliseconds(i ? 100 : 0));
            ipp_t* request = ippNewRequest(IPP_OP_GET_JOB_ATTRIBUTES);
            ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_URI, "job-uri", nullptr, uri.c_str());
            ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_NAME, "requesting-user-name", nullptr,
                         cupsUser());
            ipp_t* response = cupsDoRequest(CUPS_HTTP_DEFAULT, request, "/");
            if (ipp_attribute_t* a = ippFindAttribute(response, "job-state", IPP_TAG_ENUM))
                job.state = ippGetInteger(a, 0);
            if (ipp_attribute_t* a = ippFindAttribute(response, "job-name", IPP_TAG_ZERO))
                job.name = ippGetString(a, 0, nullptr);
            if (ipp_attribute_t* a = ippFindAttribute(response, "PageSize", IPP_TAG_ZERO))
                job.pageSize = ippGetString(a, 0, nullptr);
            ippDelete(response);
        }
        return job;
    }

    testkit::ScratchDir scratch{"hf-cups"};
    const std::string device = scratch.File("device.ps"), artwork = scratch.File("art.ps");
    std::unique_ptr<cups_test::PrivateCupsd> scheduler;
};
} // namespace

// Letter and a custom size, not the queue's default A4: what the queue's
// filter selected is in the device file.
TEST_F(CupsSubmission, PaperAndNameTravelWithTheJob)
{
    const struct
    {
        printing::OptionList options;
        std::string title, name, pageSize, selected;
    } cases[] = {
        {{{"PageSize", "Letter"}},
         "artwork.eps",
         "artwork.eps",
         "Letter",
         "%%BeginFeature: *PageSize Letter\n<</PageSize[612 792]/ImagingBBox null>>setpagedevice"},
        {{{"PageSize", "Custom"}, {"CustomPageSize", "300.000000 400.000000"}},
         "",
         "art.ps",
         "Custom.300x400",
         "%%BeginFeature: *CustomPageSize True\n300\n400\n"},
    };
    for (const auto& c : cases)
    {
        std::string error;
        int id = 0;
        ASSERT_TRUE(SubmitToCups(kQueue, artwork, c.title, c.options, error, &id)) << error;
        EXPECT_GT(id, 0);
        const Job job = Finished(id);
        ASSERT_EQ(job.state, IPP_JSTATE_COMPLETED) << scheduler->Log();
        EXPECT_EQ(job.name, c.name) << "an empty title names the job after the file";
        EXPECT_EQ(job.pageSize, c.pageSize);
        const std::string printed = testkit::ReadFile(device);
        EXPECT_NE(printed.find("hf-marker"), std::string::npos);
        EXPECT_NE(printed.find(c.selected), std::string::npos) << printed;
    }
}

TEST_F(CupsSubmission, FailuresSayWhyAndLeaveNoJob)
{
    std::string error;
    EXPECT_FALSE(SubmitToCups("no_such_queue", artwork, "a", {}, error));
    EXPECT_NE(error.find("no_such_queue"), std::string::npos) << error;
    error.clear();
    EXPECT_FALSE(SubmitToCups(kQueue, scratch.File("missing.ps"), "m", {}, error));
    EXPECT_NE(error.find("missing.ps"), std::string::npos) << error;
    cups_job_t* jobs = nullptr;
    const int count = cupsGetJobs2(CUPS_HTTP_DEFAULT, &jobs, kQueue, 0, CUPS_WHICHJOBS_ALL);
    cupsFreeJobs(count, jobs);
    EXPECT_EQ(count, 0);

    scheduler->Stop(); // a scheduler that is gone
    error.clear();
    EXPECT_FALSE(SubmitToCups(kQueue, artwork, "a", {{"PageSize", "A4"}}, error));
    EXPECT_GT(error.size(), std::string("cannot create a job on ").size() + 15) << error;
}
