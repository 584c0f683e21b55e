// Stands in for Ghostscript where a test asks who runs the preflight: it
// names its user, group and supplementary group ids on standard error and
// fails, so that the job's failure line carries them.
#include <unistd.h>

#include <cstdio>

int main()
{
    uid_t ruid = 0, euid = 0, suid = 0;
    gid_t rgid = 0, egid = 0, sgid = 0;
    getresuid(&ruid, &euid, &suid);
    getresgid(&rgid, &egid, &sgid);
    gid_t groups[256];
    const int count = getgroups(256, groups);
    std::fprintf(stderr, "uid %u %u %u gid %u %u %u groups", ruid, euid, suid, rgid, egid, sgid);
    for (int i = 0; i < count; ++i)
        std::fprintf(stderr, " %u", groups[i]);
    std::fprintf(stderr, "\n");
    return 1;
}
