#pragma once
// Where the embedded document starts in the generated job.
#include <string>

// Large bodies start in the output at the same offset modulo this boundary
// as in the input: the page cache then copies them whole folio by folio, as
// fast as a plain copy of the file; at any other offset the kernel copy
// takes up to half as long again.
constexpr unsigned long kBodyAlignment = 1ul << 16;
// Smaller bodies are left where they fall: the padding would outweigh the gain.
constexpr unsigned long kAlignedBodyMinimum = 8ul << 20;

// Pads header (ending with its %%BeginDocument line) with comment lines
// before that line, so that a body of bodyLength bytes read from bodyOffset
// of the input starts on that boundary as described; small bodies leave
// the header as it is.
void AlignBodyStart(std::string& header, unsigned long bodyOffset, unsigned long bodyLength);
