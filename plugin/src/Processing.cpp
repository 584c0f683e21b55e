// One accepted job through the converter.
#include <wx/filename.h>

#include "EPS.h"
#include "EPStoPS.h"
#include "ErrorCodes.h"

long EPS::Process(const wxString& /*source*/, const ReadyToProcessJobInfo& job,
                  const wxString& outputFolder, wxString& outputName, IProgressTracker* tracker)
{
    m_lFailureCode = HF_NO_ERROR;
    m_strFailureReason.clear();
    const wxArrayString files = job.files;
    void* context = nullptr;
    if (files.empty())
        return m_lStatus = HF_INPUT_FILE_NOT_FOUND;
    if (job.filterId.empty())
        return m_lStatus = HF_FILTER_NOT_INITIALIZED;

    int lastResult = 0;
    std::string lastReason;
    for (const wxString& path : files)
    {
        const wxFileName input(path, wxPATH_NATIVE);
        const wxString inputPath = input.GetFullPath();
        wxString outputFile;
        if (m_bOutputTypeIsOne)
        {
            outputName = input.GetFullName();
            m_lStatus = HF_NO_ERROR;
        }
        else
        {
            outputFile = input.GetName() + ".ps";
        }
        const wxString outputPath = outputFolder + wxFileName::GetPathSeparator() + outputFile;

        if (tracker)
            tracker->ReportProgress(inputPath, 10);

        if (m_bOutputTypeIsOne)
        {
            if (tracker)
                tracker->ReportProgress(inputPath, 100);
            lastResult = 1;
            continue;
        }

        // Earlier outputs stay for the host when a file stops the job.
        if (!IsThisEPS(inputPath.fn_str(), &context))
            return FailProcess(HF_INVALID_INPUT_FILE, EPStoPSFailureReason());
        if (!CheckEPSInput(context))
        {
            EPStoPSfreeMemory(&context);
            return FailProcess(HF_INVALID_INPUT_FILE, EPStoPSFailureReason());
        }
        lastResult = ConvertEPStoPS(&context, &m_params, outputPath.fn_str());
        lastReason = EPStoPSFailureReason();
        EPStoPSfreeMemory(&context);
        outputName = outputFile;
        if (tracker)
            tracker->ReportProgress(inputPath, 100);
    }

    // Only the last file decides the job's result.
    if (lastResult == 1)
    {
        if (!m_bSubstrateFamilySupported)
            WriteJobOverrides(outputFolder);
        return m_lStatus;
    }
    return FailProcess(HF_FILTER_CONVERSION_FAILED, lastReason);
}

long EPS::FailProcess(long code, const std::string& reason)
{
    m_lFailureCode = code;
    m_strFailureReason = wxString::FromUTF8(reason);
    return m_lStatus = code;
}
