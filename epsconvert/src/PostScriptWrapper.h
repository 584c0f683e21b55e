#pragma once
// The text that surrounds the embedded EPS program in the generated job.
// Numbers are always printed with "." as decimal point.
#include <string>

#include "PageLayout.h"

// The DSC header, setup, page setup and the wrapper prologue, CR LF ended.
// setPageDevice may be null.
std::string FormatWrapperHeader(const char* docName, const char* creationDate,
                                const PageLayout& layout, const char* setPageDevice);

// Ends the embedded document, cleans up after it and prints the page.
const char* WrapperTrailer();

// The current local time as the header's creation date.
std::string CurrentCreationDate();
