#include "ModuleLocator.h"

#include <cstdlib>
#include <limits.h>
#include <unistd.h>

#include <wx/filename.h>

static wxString ExecutableDirectory()
{
    char buffer[PATH_MAX];
    ssize_t length = readlink("/proc/self/exe", buffer, sizeof(buffer) - 1);
    if (length <= 0)
        return wxString();
    buffer[length] = '\0';
    return wxFileName(wxString(buffer, *wxConvFileName)).GetPath();
}

wxString LocateFilterModule(const wxString& explicitPath)
{
    if (!explicitPath.empty())
        return explicitPath;
    if (const char* fromEnvironment = std::getenv("HOTFOLDER_MODULE"))
        if (*fromEnvironment)
            return wxString(fromEnvironment, *wxConvFileName);
    wxFileName module(ExecutableDirectory(), "EPS.so");
    module.AppendDir("..");
    module.AppendDir("lib");
    module.AppendDir("hotfolder");
    module.AppendDir("filters");
    module.Normalize(wxPATH_NORM_DOTS | wxPATH_NORM_ABSOLUTE);
    return module.GetFullPath();
}
