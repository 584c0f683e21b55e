// Folders bound to CUPS queues, against a scheduler of the test's own.
#include "HostScript.h"

using host_test::HostScript;

TEST_F(HostScript, Printing)
{
    Run("printing.txt");
}
