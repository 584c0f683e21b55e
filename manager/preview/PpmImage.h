#pragma once
// Ghostscript's raw PPM output (P6, 8 bits a sample) read into an image by
// hand, so that no image handler needs to be set up off the main thread.
#include <string>

#include <wx/image.h>

// The image in bytes; an invalid image when they are no complete P6 file.
wxImage DecodePpm(const std::string& bytes);
