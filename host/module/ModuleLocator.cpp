#include "module/ModuleLocator.h"

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

static wxString ModuleBelow(const wxString& executableDirectory, const wxString& libDirectory)
{
    wxFileName module(executableDirectory, "EPS.so");
    module.AppendDir("..");
    for (const wxString& part : wxSplit(libDirectory, '/'))
        if (!part.empty())
            module.AppendDir(part);
    module.AppendDir("hotfolder");
    module.AppendDir("filters");
    module.Normalize(wxPATH_NORM_DOTS | wxPATH_NORM_ABSOLUTE);
    return module.GetFullPath();
}

wxString LocateFilterModule(const wxString& explicitPath)
{
    if (!explicitPath.empty())
        return explicitPath;
    if (const char* fromEnvironment = std::getenv("HOTFOLDER_MODULE"))
        if (*fromEnvironment)
            return wxString(fromEnvironment, *wxConvFileName);
    const wxString directory = ExecutableDirectory();
    const wxString usual = ModuleBelow(directory, "lib");
#ifdef HF_INSTALLED_LIBDIR
    if (!wxFileName::FileExists(usual))
    {
        const wxString installed = ModuleBelow(directory, HF_INSTALLED_LIBDIR);
        if (wxFileName::FileExists(installed))
            return installed;
    }
#endif
    return usual;
}
