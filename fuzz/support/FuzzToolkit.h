#pragma once
// What the entry points of the toolkit-based readers add to FuzzSupport.h: a
// toolkit initialised once with its log silenced, and bytes as text.
#include <cstddef>
#include <cstdint>

#include <wx/string.h>

#include "FuzzSupport.h"

namespace fuzzsupport
{
// InitialiseOnce, then the toolkit; later calls do nothing.
void InitialiseToolkitOnce();

// The bytes as text the way the client receives them: UTF-8 when they are
// valid UTF-8, else one character per byte, so no input is lost as empty.
wxString TextOf(const uint8_t* data, size_t size);
} // namespace fuzzsupport
