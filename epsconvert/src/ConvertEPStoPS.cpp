// Wraps the EPS program of a recognised file in a one-page PostScript job.
#include <cerrno>
#include <cstdio>
#include <string>

#include "EPStoPS.h"
#include "EngineMessages.h"
#include "FailureRecord.h"
#include "posix/ErrorText.h"
#include "LocaleDecimalPoint.h"
#include "PageLayout.h"
#include "PostScriptWrapper.h"

namespace
{
void RecordWriteFailure(const char* outputPath, int error)
{
    RecordFailure(EPS_FAILURE_RESOURCES, "cannot write " + ShownFileName(outputPath) +
                                             (error ? ": " + posix::ErrorText(error) : ""));
}

void ReplaceAll(std::string& text, const std::string& from, const std::string& to)
{
    if (from.empty())
        return;
    for (size_t at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size()))
        text.replace(at, from.size(), to);
}

// False when the header could not be written; the caller then stops.
bool WriteHeader(FILE* out, std::string header, const std::string& decimalPoint)
{
    if (LocaleUsesFullStop(decimalPoint))
    {
        if (header.empty() || fwrite(header.data(), 1, header.size(), out) != header.size())
        {
            WriteEngineMessage("Error from fwrite in ConvertEPStoPS\n");
            return false;
        }
        return true;
    }
    // The numbers already carry "."; what the host expects besides is that the
    // locale's decimal point turns into "." in the texts too (the title and
    // the setpagedevice text).
    if (header.empty())
    {
        WriteEngineMessage("Error from fwrite in ConvertEPStoPS\n");
        return false;
    }
    ReplaceAll(header, decimalPoint, ".");
    return fwrite(header.data(), 1, header.size(), out) == header.size();
}
} // namespace

int ConvertEPStoPS(void** context, const EPStoPSparams_t* params, const char* outputPath)
{
    ClearFailure();
    const std::string decimalPoint = CurrentLocaleDecimalPoint();
    if (!context || !*context)
    {
        RecordFailure(EPS_FAILURE_RESOURCES, "no file description was given");
        return 0;
    }
    auto* info = static_cast<EPSinfo_t*>(*context);

    errno = 0;
    FILE* out = (params && outputPath) ? fopen(outputPath, "wb") : nullptr;
    if (!out)
    {
        if (params && outputPath)
            RecordWriteFailure(outputPath, errno);
        else
            RecordFailure(EPS_FAILURE_RESOURCES, "no output was given");
        EPStoPSfreeMemory(context);
        return 0;
    }

    const PageLayout layout = ComputePageLayout(*params, info->boundingBox);
    const std::string header = FormatWrapperHeader(info->docName, CurrentCreationDate().c_str(),
                                                   layout, params->setPageDeviceString);
    int result = 0;
    errno = 0;
    if (WriteHeader(out, header, decimalPoint))
    {
        ExtractEPSfromTIFFpreview(info->epsFile, out, static_cast<long>(info->psOffset),
                                  static_cast<long>(info->psLength));
        const char* trailer = WrapperTrailer();
        if (fputs(trailer, out) < 0)
        {
            RecordWriteFailure(outputPath, errno);
            WriteEngineMessage("Error from fwrite in ConvertEPStoPS\n");
        }
        else
            result = 1;
    }
    else
        RecordWriteFailure(outputPath, errno);

    EPStoPSfreeMemory(context);
    // Buffered bytes reach the file only here; a failure now is a failed job.
    if (fclose(out) != 0 && result)
    {
        RecordWriteFailure(outputPath, errno);
        result = 0;
    }
    return result;
}
