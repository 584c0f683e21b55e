#pragma once
// Manager core tests: a scratch directory with its own warehouse, so the
// machine-wide list and markers are the test's own, and hot folders made
// there through the manager's own Add.
#include <cstdlib>
#include <string>

#include <gtest/gtest.h>
#include <wx/init.h>

#include "TestKit.h"
#include "core/FolderSetup.h"

namespace core_test
{
// The toolkit's base for the whole run (string conversions, the module's XML).
class ToolkitEnvironment : public ::testing::Environment
{
public:
    void SetUp() override { m_initializer = std::make_unique<wxInitializer>(); }
    void TearDown() override { m_initializer.reset(); }

private:
    std::unique_ptr<wxInitializer> m_initializer;
};

inline ::testing::Environment* const kToolkit =
    ::testing::AddGlobalTestEnvironment(new ToolkitEnvironment);

class CoreTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        setenv("HOTFOLDER_WAREHOUSE_ROOT", (scratch + "/machine").c_str(), 1);
        unsetenv("HOTFOLDER_MODULE");
    }

    // A listed hot folder printing nowhere, or fails the test.
    std::string MakeFolder(const std::string& name, const PrinterChoice& choice = {})
    {
        const std::string folder = scratch + "/" + name;
        wxString warnings, error;
        EXPECT_TRUE(CreateHotFolder(folder, name, choice, HF_MODULE_PATH, warnings, error))
            << error;
        return folder;
    }

    std::string Container(const std::string& folder) { return folder + "/[_Orv_HotFolder_]"; }

    testkit::ScratchDir scratchDir{"hf-manager-test"};
    const std::string scratch = scratchDir.Path();
};
} // namespace core_test
