// Hosts and modules are built apart: the slot of every virtual function of
// the interface must stay where hosts expect it.
#include <cstring>

#include <gtest/gtest.h>
#include <hotfolder/HFPlugin.h>

namespace
{
// Under the Itanium C++ ABI a pointer to a virtual member function holds
// 1 + the byte offset of its slot in the vtable.
template <typename F> long SlotOf(F function)
{
    struct Representation
    {
        uintptr_t ptr;
        ptrdiff_t adj;
    } rep;
    static_assert(sizeof(F) == sizeof(Representation));
    std::memcpy(&rep, &function, sizeof rep);
    return static_cast<long>((rep.ptr - 1) / sizeof(void*));
}
} // namespace

TEST(InterfaceLayout, SlotsInHostOrder)
{
    EXPECT_EQ(SlotOf(&HFPlugin::Initialize), 2);
    EXPECT_EQ(SlotOf(&HFPlugin::InitilaizeFromPreference), 3);
    EXPECT_EQ(SlotOf(&HFPlugin::GetVersion), 4);
    EXPECT_EQ(SlotOf(&HFPlugin::GetDisplayName), 5);
    EXPECT_EQ(SlotOf(&HFPlugin::GetShortName), 6);
    EXPECT_EQ(SlotOf(&HFPlugin::GetSupportedFileExtensions), 7);
    EXPECT_EQ(SlotOf(&HFPlugin::GetGroupType), 8);
    EXPECT_EQ(SlotOf(&HFPlugin::ShowPluginUI), 9);
    EXPECT_EQ(SlotOf(&HFPlugin::GetErrorString), 10);
    EXPECT_EQ(SlotOf(&HFPlugin::SniffFiles), 11);
    using WithContent =
        long (HFPlugin::*)(const wxString&, wxArrayString&, JobInfoCollection&, FolderContent*&);
    using WithoutContent = long (HFPlugin::*)(const wxString&, wxArrayString&, JobInfoCollection&);
    EXPECT_EQ(SlotOf(static_cast<WithContent>(&HFPlugin::SniffFolder)), 12);
    EXPECT_EQ(SlotOf(static_cast<WithoutContent>(&HFPlugin::SniffFolder)), 13);
    EXPECT_EQ(SlotOf(&HFPlugin::Process), 14);
    EXPECT_EQ(SlotOf(&HFPlugin::SavePreference), 15);
    EXPECT_EQ(SlotOf(&HFPlugin::LoadPreference), 16);
    EXPECT_EQ(SlotOf(&HFPlugin::IsInitialized), 17);
    EXPECT_EQ(SlotOf(&HFPlugin::DeInitialize), 18);
    EXPECT_EQ(SlotOf(&HFPlugin::GetServerKeys), 19);
    EXPECT_EQ(SlotOf(&HFPlugin::IsMergeEnabled), 20);
    EXPECT_EQ(SlotOf(&HFPlugin::EnableMerge), 21);
    EXPECT_EQ(SlotOf(&IProgressTracker::ReportProgress), 0);
}

TEST(InterfaceLayout, DescriptionRecordOrder)
{
    // Offsets measured on an object: the record holds wx members, so it is
    // not standard layout and offsetof is not portable on it.
    const PluginInfo info;
    auto at = [&info](const void* member)
    { return static_cast<const char*>(member) - reinterpret_cast<const char*>(&info); };
    EXPECT_EQ(at(&info.m_llKind), 0);
    EXPECT_LT(at(&info.m_strVersion), at(&info.m_strIdentifier));
    EXPECT_LT(at(&info.m_strIdentifier), at(&info.m_strDisplayName));
    EXPECT_LT(at(&info.m_strDisplayName), at(&info.m_arrExtensions));
    EXPECT_LT(at(&info.m_arrExtensions), at(&info.m_strHostReserved));
    EXPECT_EQ(at(&info.m_arrRequiredServerFeatures) - at(&info.m_strHostReserved),
              static_cast<ptrdiff_t>(sizeof(wxString)));
}

TEST(JobCollection, OwnsCopiesInOrder)
{
    ReadyToProcessJobInfo job;
    job.filterId = "Orv.EPS.1";
    job.jobName = "a.eps";
    job.files.Add("/in/a.eps");
    job.auxValue = 7;
    JobInfoCollection jobs;
    jobs.Add(job, 2);
    job.jobName = "b.eps";
    jobs.Add(job);
    ASSERT_EQ(jobs.GetCount(), 3u);
    EXPECT_EQ(jobs[0].jobName, "a.eps");
    EXPECT_EQ(jobs[1].jobName, "a.eps");
    EXPECT_EQ(jobs[2].jobName, "b.eps");
    EXPECT_NE(&jobs[0], &jobs[1]);
    EXPECT_EQ(jobs[1].files[0], "/in/a.eps");
    EXPECT_EQ(jobs[1].auxValue, 7u);
}
