#pragma once
// The whole host contract of a hot-folder input filter.
#include <cstddef>

#include <wx/arrstr.h>
#include <wx/string.h>
#include "hotfolder/Export.h"
#include "hotfolder/FolderContent.h"
#include "hotfolder/HFTranslations.h"
#include "hotfolder/IProgressTracker.h"
#include "hotfolder/JobInfo.h"
#include "hotfolder/MapPropToValue.h"
#include "hotfolder/PluginInfo.h"
#include "hotfolder/ServerInfo.h"
#include "hotfolder/Themer.h"

class wxWindow;
class wxXmlNode;

// The interface a host drives a filter object through.
//
// The order of the virtual functions below IS the binary interface between
// hosts and filter modules built apart: slot 0 and 1 are the destructor,
// then Initialize is slot 2, and so on in declaration order. Never reorder,
// insert or remove; overloads keep their declaration order.
class HF_SDK_API HFPlugin
{
public:
    virtual ~HFPlugin();
    virtual long Initialize(const wxString& serverDescription) = 0;
    virtual long InitilaizeFromPreference(wxXmlNode* preference) = 0;
    virtual void GetVersion(wxString& out) = 0;
    virtual void GetDisplayName(wxString& out) = 0;
    virtual void GetShortName(wxString& out) = 0;
    virtual void GetSupportedFileExtensions(wxArrayString& extensions, wxArrayString& second) = 0;
    virtual int GetGroupType() = 0;
    virtual wxWindow* ShowPluginUI(wxWindow* parent) = 0;
    virtual bool GetErrorString(long code, wxString& out) = 0;
    virtual long SniffFiles(const wxArrayString& files, wxArrayString& second,
                            wxArrayString& rejected, JobInfoCollection& jobs) = 0;
    virtual long SniffFolder(const wxString& folder, wxArrayString& rejected,
                             JobInfoCollection& jobs, FolderContent*& content) = 0;
    virtual long SniffFolder(const wxString& folder, wxArrayString& rejected,
                             JobInfoCollection& jobs) = 0;
    virtual long Process(const wxString& source, const ReadyToProcessJobInfo& job,
                         const wxString& outputFolder, wxString& outputName,
                         IProgressTracker* tracker) = 0;
    virtual long SavePreference(wxXmlNode* node) = 0;
    virtual long LoadPreference(wxXmlNode* node) = 0;
    virtual bool IsInitialized() = 0;
    virtual long DeInitialize() = 0;
    virtual void GetServerKeys(wxArrayString& keys) = 0;
    // Merging is not offered by the base class: always false, and the
    // setter does nothing.
    virtual bool IsMergeEnabled();
    virtual void EnableMerge(const bool& enable);
};

// The module's entry points, looked up by name with dlsym.
extern "C"
{
    typedef void (*InitializePluginFn)();
    typedef void (*UninitializePluginFn)();
    typedef void (*GetPluginInfoFn)(PluginInfo*);
    typedef HFPlugin* (*GetPluginInstanceFn)(const wchar_t*);
    typedef void (*ReleasePluginInstanceFn)(HFPlugin*);
    // Optional, "DescribeRefusal": why the module's filter does not take the
    // file at path (in the file system's encoding) as a job, a sentence for
    // an operator in UTF-8. Writes at most size bytes, its terminating NUL
    // included, into text and returns the sentence's whole length (without
    // the NUL); 0 when the filter would take the file. A host works without
    // it when a module lacks it.
    typedef size_t (*DescribeRefusalFn)(const char* path, char* text, size_t size);
}
