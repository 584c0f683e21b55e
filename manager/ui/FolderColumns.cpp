#include "ui/FolderColumns.h"

#include <wx/intl.h>

#include "posix/NativePath.h"

namespace
{
wxString Shown(const wxString& text)
{
    return posix::ShownLine(text);
}

wxString Count(size_t n)
{
    return wxString::Format("%zu", n);
}

// The queue the outputs go to; a folder with a server description but no
// queue makes outputs for that printer and keeps them.
wxString PrinterText(const FolderStatus& status)
{
    if (!status.queue.empty())
        return Shown(wxString::FromUTF8(status.queue));
    if (!status.server.empty())
        return wxString::Format(_("%s, output only"), Shown(status.server));
    return _("output only");
}

// The status code's English words for the output type and a custom page,
// in the window's language; paper names stay as the printer calls them.
wxString OutputTypeText(const FolderStatus& status)
{
    return wxGetTranslation(status.outputType);
}

wxString PageText(const FolderStatus& status)
{
    return status.page == "custom" ? wxGetTranslation(status.page) : Shown(status.page);
}

wxString PrinterStateText(const FolderStatus& status)
{
    if (!status.problem.empty())
        return wxString::Format(_("cannot be served: %s"), Shown(status.problem));
    if (status.queue.empty())
        return wxString();
    // The scheduler's words for its three states read in the window's
    // language; anything else is shown as it came.
    wxString text = wxGetTranslation(Shown(wxString::FromUTF8(status.queueState)));
    for (const std::string& reason : status.queueReasons)
        text += (text.empty() ? "" : ", ") + Shown(wxString::FromUTF8(reason));
    if (!status.printingHeld.empty())
        text += (text.empty() ? "" : "; ") + Shown(status.printingHeld);
    if (status.printing > 0)
        text += (text.empty() ? "" : "; ") + wxString::Format(_("%zu on the way"), status.printing);
    return text;
}
} // namespace

std::vector<wxString> FolderColumnHeadings()
{
    return {_("Name"),          _("Folder"),       _("Printer"),    _("Paper"),
            _("Output type"),   _("Waiting"),      _("Done today"), _("Failed today"),
            _("Printed today"), _("Printer state")};
}

std::vector<wxString> FolderColumnTexts(const FolderRow& row)
{
    const FolderStatus& status = row.status;
    return {Shown(row.name),         Shown(row.path),           PrinterText(status),
            PageText(status),        OutputTypeText(status),    Count(status.waiting),
            Count(status.doneToday), Count(status.failedToday), Count(status.printedToday),
            PrinterStateText(status)};
}

std::vector<wxString> JobColumnHeadings()
{
    return {_("Time"), _("File"), _("Outcome"), _("Reason")};
}

std::vector<wxString> JobColumnTexts(const JobEntry& job, const wxDateTime& now)
{
    wxString time;
    if (job.time.IsValid())
        time = job.time.IsSameDate(now) ? job.time.Format("%H:%M:%S")
                                        : job.time.Format("%Y-%m-%d %H:%M");
    return {time, Shown(job.name), JobOutcomeText(job.outcome), Shown(job.reason)};
}
