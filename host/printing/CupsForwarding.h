#pragma once
#include <string>
#include <utility>
#include <vector>

#include <wx/string.h>

// Handing a delivered output on to a print queue ("run --submit cups:QUEUE").

// Reads "cups:QUEUE". False with a message when the text does not have that
// form or names no queue.
bool ParseSubmitTarget(const std::string& text, std::string& queue, wxString& error);

// The job options of a delivered output: the overrides the filter merged
// into its ticket (its paper above all), which the queue must apply too.
std::vector<std::pair<std::string, std::string>> TicketOptions(const wxString& ticket);
