#include "module/ModuleLocator.h"

#include <cstdlib>

#include <wx/filename.h>

#include "posix/ExecutablePath.h"
#include "posix/NativePath.h"

static wxString ExecutableDirectory()
{
    const std::string program = posix::ExecutablePath();
    if (program.empty())
        return wxString();
    return wxFileName(posix::FromNativePath(program.c_str())).GetPath();
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
            return posix::FromNativePath(fromEnvironment);
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
