#pragma once
// Points the machine-wide store at a scratch folder for one test.
#include <gtest/gtest.h>

#include <sys/stat.h>

#include <wx/utils.h>

#include "TestKit.h"

namespace machinetest
{
inline wxString Wx(const std::string& path)
{
    return wxString::FromUTF8(path);
}

inline unsigned ModeOf(const std::string& path)
{
    struct stat info;
    return ::stat(path.c_str(), &info) == 0 ? (info.st_mode & 07777) : 0xFFFFu;
}

class WarehouseTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        m_hadRoot = wxGetEnv("HOTFOLDER_WAREHOUSE_ROOT", &m_oldRoot);
        wxSetEnv("HOTFOLDER_WAREHOUSE_ROOT", Wx(m_root.Path()));
    }
    void TearDown() override
    {
        if (m_hadRoot)
            wxSetEnv("HOTFOLDER_WAREHOUSE_ROOT", m_oldRoot);
        else
            wxUnsetEnv("HOTFOLDER_WAREHOUSE_ROOT");
    }
    std::string Warehouse() const { return m_root.File("HotFolders"); }

    testkit::ScratchDir m_root;
    bool m_hadRoot = false;
    wxString m_oldRoot;
};

// Runs a block under a restrictive umask and restores the old one.
class ScopedUmask
{
public:
    explicit ScopedUmask(mode_t mask) : m_old(::umask(mask)) {}
    ~ScopedUmask() { ::umask(m_old); }

private:
    mode_t m_old;
};
} // namespace machinetest
