#pragma once
#include <string>
#include <vector>

#include <hotfolder/HFPlugin.h>

#include "EPStoPSparams.h"
#include "db/PageAttributes.h"

class ImageSizePanelWithoutMerge;

// The filter for Encapsulated PostScript files.
class EPS : public HFPlugin
{
public:
    explicit EPS(wxString name);
    ~EPS() override;
    EPS(const EPS&) = delete;
    EPS& operator=(const EPS&) = delete;

    long Initialize(const wxString& serverDescription) override;
    long InitilaizeFromPreference(wxXmlNode* preference) override;
    void GetVersion(wxString& out) override;
    void GetDisplayName(wxString& out) override;
    void GetShortName(wxString& out) override;
    void GetSupportedFileExtensions(wxArrayString& extensions, wxArrayString& second) override;
    int GetGroupType() override;
    wxWindow* ShowPluginUI(wxWindow* parent) override;
    // The code a failed Process returned reads with its reason appended
    // ("Invalid input file: cannot read a.eps: Permission denied") until the
    // next Process, also after the host initialises the object again.
    bool GetErrorString(long code, wxString& out) override;
    long SniffFiles(const wxArrayString& files, wxArrayString& second, wxArrayString& rejected,
                    JobInfoCollection& jobs) override;
    long SniffFolder(const wxString& folder, wxArrayString& rejected, JobInfoCollection& jobs,
                     FolderContent*& content) override;
    long SniffFolder(const wxString& folder, wxArrayString& rejected,
                     JobInfoCollection& jobs) override;
    long Process(const wxString& source, const ReadyToProcessJobInfo& job,
                 const wxString& outputFolder, wxString& outputName,
                 IProgressTracker* tracker) override;
    long SavePreference(wxXmlNode* node) override;
    long LoadPreference(wxXmlNode* node) override;
    bool IsInitialized() override;
    long DeInitialize() override;
    void GetServerKeys(wxArrayString& keys) override;

    // Rebuilds m_params from m_settings.
    void LoadEPSParams();
    // Hands the chosen page size to the print server through Folder.cfg.
    bool WriteJobOverrides(wxString folder);
    bool IsPPMLFolder(const wxString& folder);

    // Read access for hosts' tests and the settings panel.
    const EPStoPSparams_t& GetParams() const { return m_params; }
    MapPropToValue& GetSettings() { return m_settings; }
    long GetStatus() const { return m_lStatus; }
    bool IsFilterEnabled() const { return m_bFilterEnabled; }
    bool IsOutputTypeOne() const { return m_bOutputTypeIsOne; }
    bool IsSubstrateFamilySupported() const { return m_bSubstrateFamilySupported; }
    const std::vector<stPageAttribute>& GetSheetList() const { return m_sheetList; }
    const stPageAttribute& GetDefaultSheet() const { return m_defaultSheet; }
    const stCustomPageSizeAttribute& GetCustomPageSizeInfo() const { return m_customPageSizeInfo; }
    const wxString& GetServerDescription() const { return m_strServerDescription; }

private:
    enum class SniffMode
    {
        Files,
        Folder
    };
    // The test of one candidate file shared by the sniffing operations.
    enum class SniffResult
    {
        EmptyPath,
        Refused,
        NotEPS,
        Accepted
    };
    // nativePath, when given, is path already in the file system's encoding.
    SniffResult SniffOne(const wxString& path, const char* nativePath, const wxString& filterId,
                         JobInfoCollection& jobs);
    // A file found in a folder: refusals go to rejected, an .eps that is not
    // EPS is dropped.
    SniffResult SniffListed(const wxString& path, const char* nativePath, const wxString& filterId,
                            wxArrayString& rejected, JobInfoCollection& jobs);
    long SniffFileList(const wxArrayString& files, wxArrayString& rejected,
                       JobInfoCollection& jobs);
    void ReadUIElement(wxXmlNode* node);
    // Ends Process with code and the reason the engine recorded.
    long FailProcess(long code, const std::string& reason);

    bool m_bFilterEnabled = false;
    bool m_bOutputTypeIsOne = false;
    int32_t m_nResolution = 600;
    long m_lStatus = 0;
    wxString m_strReserved1;
    wxString m_strServerDescription;
    wxArrayString m_arrSheetNames;
    std::vector<stPageAttribute> m_sheetList;
    stPageAttribute m_defaultSheet;
    ImageSizePanelWithoutMerge* m_pSettingsPanel = nullptr; // owned by the host's window tree
    MapPropToValue m_settings;
    EPStoPSparams_t m_params;
    stCustomPageSizeAttribute m_customPageSizeInfo;
    wxString m_strReserved2;
    bool m_bSubstrateFamilySupported = false;
    long m_lFailureCode = 0; // what the last Process returned when it failed
    wxString m_strFailureReason;
};

// Why the filter does not take the file at nativePath (in the file system's
// encoding) as a job, as a sentence for an operator; "" when the file is EPS.
// A file named .eps that cannot be read or is a damaged DOS EPS binary gets
// its reason too: a converting filter takes it so that its job fails with it.
std::string RefusalReason(const char* nativePath);

// Keys the settings views share.
extern const wxString ERRORDIFFUSION_KEY;
extern const wxString IMAGEPRIORITY_KEY;
extern const wxString RESOLUTION_1200_KEY;
