#pragma once
// The engine's diagnostics: fixed English lines on standard error.
#include <cstdio>
#include <cstring>

inline void WriteEngineMessage(const char* text)
{
    fwrite(text, 1, std::strlen(text), stderr);
}
