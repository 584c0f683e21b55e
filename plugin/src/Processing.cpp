// One accepted job through the converter.
#include <wx/filename.h>

#include "EPS.h"
#include "EPStoPS.h"
#include "ErrorCodes.h"

long EPS::Process(const wxString& /*source*/, const ReadyToProcessJobInfo& job,
                  const wxString& outputFolder, wxString& outputName, IProgressTracker* tracker)
{
    const wxArrayString files = job.files;
    void* context = nullptr;
    if (files.empty())
        return m_lStatus = HF_INPUT_FILE_NOT_FOUND;
    if (job.filterId.empty())
        return m_lStatus = HF_FILTER_NOT_INITIALIZED;

    int lastResult = 0;
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

        if (!IsThisEPS(inputPath.fn_str(), &context))
            return m_lStatus = HF_INVALID_INPUT_FILE; // earlier outputs stay for the host
        lastResult = ConvertEPStoPS(&context, &m_params, outputPath.fn_str());
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
    return m_lStatus = HF_FILTER_CONVERSION_FAILED;
}
