// The reaper on Windows: the tests run in a job that the system ends, with every process
// started in it (their own children and those orphaned below them), once the test
// process has ended, however it ends.
#include "support/Reaper.h"

#include <windows.h>

#include <cstdio>

void RunUnderReaper()
{
    if (IsDebuggerPresent())
        return;
    // Never closed: the system closes it with the process, which ends the job.
    const HANDLE job = CreateJobObjectW(nullptr, nullptr);
    JOBOBJECT_EXTENDED_LIMIT_INFORMATION limits = {};
    limits.BasicLimitInformation.LimitFlags = JOB_OBJECT_LIMIT_KILL_ON_JOB_CLOSE;
    if (!job ||
        !SetInformationJobObject(job, JobObjectExtendedLimitInformation, &limits, sizeof(limits)) ||
        !AssignProcessToJobObject(job, GetCurrentProcess()))
        fprintf(stderr, "the tests run without a job: what they leave running stays\n");
}
