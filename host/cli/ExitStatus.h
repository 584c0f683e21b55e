#pragma once

// Exit statuses of every sub-command, in one place so that scripts can rely
// on them whichever command they run.
enum ExitStatus
{
    kExitSuccess = 0,     // everything asked for was done
    kExitJobsFailed = 1,  // the run went through, but some job failed
    kExitUsage = 2,       // bad command line
    kExitSetupFailed = 3, // the module, the folder or its configuration is unusable
};
