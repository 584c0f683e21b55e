// The worker: a newer request stops an older one's Ghostscript and the
// older result is never handed out; closing stops Ghostscript at once; a
// step before rendering runs on the worker, and a request's scratch file
// goes with it.
#include <atomic>
#include <memory>
#include <thread>

#include "PreviewTestSupport.h"
#include "preview/PreviewWorker.h"

namespace
{
struct Calls
{
    std::atomic<int> slow{0}, quick{0};
    std::atomic<bool> quickOk{false};
};

TEST(PreviewWorker, ANewerRequestSupersedesAHangingOne)
{
    testkit::ScratchDir scratch("hf-preview-worker");
    const std::string page = scratch.File("page.ps");
    testkit::WriteFile(page, "%!PS\n10 10 moveto 50 50 lineto stroke showpage\n");
    PreviewOptions slow;
    slow.ghostscript = preview_test::WriteSleeper(scratch.Path());
    slow.timeoutSeconds = 120;
    Calls calls;
    PreviewWorker worker;
    worker.Request(page, slow, [&](const PagePreview&) { ++calls.slow; });
    ASSERT_TRUE(testkit::WaitFor([&] { return testkit::Exists(scratch.File("started")); }, 20000));
    worker.Request(page, PreviewOptions(),
                   [&](const PagePreview& preview)
                   {
                       calls.quickOk = preview.ok;
                       ++calls.quick;
                   });
    // Well before the hanging one's own end: it was stopped.
    ASSERT_TRUE(testkit::WaitFor([&] { return calls.quick > 0; }, 40000));
    EXPECT_TRUE(calls.quickOk);
    EXPECT_EQ(calls.slow, 0);
    EXPECT_EQ(calls.quick, 1);
}

TEST(PreviewWorker, ClosingStopsAHangingGhostscript)
{
    testkit::ScratchDir scratch("hf-preview-worker");
    const std::string page = scratch.File("page.ps");
    testkit::WriteFile(page, "%!PS\nshowpage\n");
    PreviewOptions slow;
    slow.ghostscript = preview_test::WriteSleeper(scratch.Path());
    slow.timeoutSeconds = 120;
    Calls calls;
    std::atomic<bool> closed{false};
    std::thread closer;
    {
        auto worker = std::make_unique<PreviewWorker>();
        worker->Request(page, slow, [&](const PagePreview&) { ++calls.slow; });
        ASSERT_TRUE(
            testkit::WaitFor([&] { return testkit::Exists(scratch.File("started")); }, 20000));
        closer = std::thread(
            [&]
            {
                worker.reset();
                closed = true;
            });
        // Well before the stand-in's sleep of 60 s or its time limit ends.
        EXPECT_TRUE(testkit::WaitFor([&] { return closed.load(); }, 40000));
        closer.join();
    }
    EXPECT_EQ(calls.slow, 0);
}
TEST(PreviewWorker, ANewerRequestDropsTheOneStillPreparingAndItsScratchFile)
{
    testkit::ScratchDir scratch("hf-preview-worker");
    const std::string made = scratch.File("made.ps"), missing = scratch.File("missing.ps");
    std::atomic<bool> preparing{false}, go{false}, onWorker{false};
    const std::thread::id window = std::this_thread::get_id();
    PreviewRequest first;
    first.postscript = made;
    first.removeAfter = true;
    first.prepare = [&](wxString&)
    {
        onWorker = std::this_thread::get_id() != window;
        preparing = true;
        testkit::WaitFor([&] { return go.load(); }, 20000);
        return testkit::WriteFile(made, "%!PS\nshowpage\n");
    };
    Calls calls;
    wxString reason;
    PreviewWorker worker;
    worker.Request(std::move(first), [&](const PagePreview&) { ++calls.slow; });
    ASSERT_TRUE(testkit::WaitFor([&] { return preparing.load(); }, 20000));
    EXPECT_TRUE(onWorker);
    worker.Request(missing, PreviewOptions(),
                   [&](const PagePreview& preview)
                   {
                       reason = preview.reason.Clone();
                       ++calls.quick;
                   });
    go = true;
    ASSERT_TRUE(testkit::WaitFor([&] { return calls.quick > 0; }, 40000));
    EXPECT_NE(wxString::npos, reason.find("cannot find the file")) << reason;
    EXPECT_EQ(calls.slow, 0);
    EXPECT_FALSE(testkit::Exists(made)) << "the dropped request's scratch file is left";
}
} // namespace
