// The client of this test program ships Resources/HFConfig.cfg with
// version 3.3, the version that follows the workstation language.
#include "ClientEnvironment.h"

namespace
{
[[maybe_unused]] ::testing::Environment* const g_environment =
    ::testing::AddGlobalTestEnvironment(new ClientEnvironment("Resources"));
}
