#pragma once
// The manager's window tests, each program including this once: the toolkit
// started before the tests, asserts that throw (failing the test) instead of
// popping up, a hook that fails any modal dialog no wxTEST_DIALOG expects so
// nothing waits for a user, and a fixture with its own scratch warehouse, so
// the machine's own hot folders are never read or changed.
#include <functional>
#include <stdexcept>

#include <gtest/gtest.h>
#include <wx/app.h>
#include <wx/modalhook.h>
#include <wx/stopwatch.h>
#include <wx/testing.h>

#include "CaseTable.h"
#include "HostTestSupport.h"
#include "ui/LiveList.h"
#include "ui/ManagerFrame.h"

namespace manager_test
{
inline bool g_guiAvailable = false;

class UnexpectedModalHook : public wxModalDialogHook
{
protected:
    int Enter(wxDialog* dialog) override
    {
        ADD_FAILURE() << "unexpected modal dialog: " << dialog->GetTitle();
        return wxID_CANCEL;
    }
    void Exit(wxDialog*) override {}
};

// Lets the window's events run until condition holds; false when the
// generous deadline passed first.
inline bool PumpUntil(const std::function<bool()>& condition, int deadlineMs = 30000)
{
    for (wxStopWatch watch; !condition(); wxMilliSleep(5))
    {
        if (watch.Time() > deadlineMs)
            return false;
        wxTheApp->ProcessPendingEvents();
        wxYield();
    }
    return true;
}

class ManagerTest : public host_test::HostTest
{
protected:
    void SetUp() override
    {
        if (!g_guiAvailable)
            GTEST_SKIP() << "no display";
        HostTest::SetUp();
    }
    void TearDown() override
    {
        if (m_frame)
            m_frame->Destroy();
        m_frame = nullptr;
        // A frame goes at idle time; its poller and preview worker end with it.
        PumpUntil([] { return wxTopLevelWindows.empty(); });
    }
    ManagerFrame& Frame()
    {
        if (!m_frame)
        {
            m_frame = new ManagerFrame(HF_MODULE_PATH);
            m_frame->SetNoticeSink([this](const Notice& notice) { notices.push_back(notice); });
            m_frame->Show();
        }
        return *m_frame;
    }
    // Waits for a rescan that began after now.
    bool Rescanned()
    {
        const size_t seen = Frame().Rescans();
        Frame().RescanNow();
        return PumpUntil([&] { return Frame().Rescans() >= seen + 2; });
    }
    std::string Cell(LiveList& list, long row, int column)
    {
        return list.GetItemText(row, column).utf8_string();
    }

    ManagerFrame* m_frame = nullptr;
    std::vector<Notice> notices;
};
} // namespace manager_test

int main(int argc, char** argv)
{
    ::testing::InitGoogleTest(&argc, argv);
    struct TestApp : wxApp
    {
        bool OnInit() override { return true; }
    };
    if (std::getenv("DISPLAY"))
    {
        wxApp::SetInstance(new TestApp);
        manager_test::g_guiAvailable = wxEntryStart(argc, argv) && wxTheApp->CallOnInit();
    }
    wxSetAssertHandler(
        [](const wxString& file, int line, const wxString& func, const wxString& cond,
           const wxString& msg)
        {
            throw std::runtime_error(
                wxString::Format("wx assert %s:%d %s: %s %s", file, line, func, cond, msg)
                    .utf8_string());
        });
    manager_test::UnexpectedModalHook hook;
    if (manager_test::g_guiAvailable)
        hook.Register();
    const int rc = RUN_ALL_TESTS();
    if (manager_test::g_guiAvailable)
    {
        hook.Unregister();
        wxEntryCleanup();
    }
    return rc;
}
