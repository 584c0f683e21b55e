#pragma once
#include <string>

#include <wx/string.h>

// Handing a delivered output on to a print queue ("run --submit cups:QUEUE").

// Reads "cups:QUEUE". False with a message when the text does not have that
// form or names no queue.
bool ParseSubmitTarget(const std::string& text, std::string& queue, wxString& error);

// Submits the delivered PostScript file to queue under jobName, with the job
// overrides the filter merged into the job's ticket as options. jobId gets
// the scheduler's job number; false with the scheduler's reason otherwise.
bool SubmitDeliveredOutput(const std::string& queue, const wxString& output, const wxString& ticket,
                           const wxString& jobName, int& jobId, wxString& error);
