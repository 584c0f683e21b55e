#pragma once
// Small EPS files written on the fly for tests: a filled rectangle that
// exactly covers its bounding box, and a DOS EPS binary around a program.
// Scratch folders and file access come from the test kit (TestKit.h).
#include <cstdint>
#include <cstdio>
#include <string>

namespace sample
{
inline std::string RectangleEps(double llx, double lly, double urx, double ury)
{
    char box[256];
    std::snprintf(box, sizeof box, "%%%%BoundingBox: %d %d %d %d\n", static_cast<int>(llx),
                  static_cast<int>(lly), static_cast<int>(urx), static_cast<int>(ury));
    std::string text = "%!PS-Adobe-3.0 EPSF-3.0\n";
    text += box;
    text += "%%Title: rectangle\n%%EndComments\n";
    char draw[256];
    std::snprintf(draw, sizeof draw,
                  "newpath %d %d moveto %d %d lineto %d %d lineto %d %d lineto closepath fill\n",
                  static_cast<int>(llx), static_cast<int>(lly), static_cast<int>(urx),
                  static_cast<int>(lly), static_cast<int>(urx), static_cast<int>(ury),
                  static_cast<int>(llx), static_cast<int>(ury));
    text += draw;
    text += "%%EOF\n";
    return text;
}

// A DOS EPS binary: 30-byte header, then the PostScript section, then a
// fake preview the converter must leave behind.
inline std::string DosEpsBinary(const std::string& postscript, const std::string& preview)
{
    std::string out(30, '\0');
    const unsigned char magic[4] = {0xC5, 0xD0, 0xD3, 0xC6};
    auto put32 = [&out](size_t at, uint32_t v)
    {
        for (int i = 0; i < 4; ++i)
            out[at + i] = static_cast<char>((v >> (8 * i)) & 0xFF);
    };
    for (int i = 0; i < 4; ++i)
        out[i] = static_cast<char>(magic[i]);
    put32(4, 30);
    put32(8, static_cast<uint32_t>(postscript.size()));
    put32(20, static_cast<uint32_t>(30 + postscript.size()));
    put32(24, static_cast<uint32_t>(preview.size()));
    out[28] = out[29] = static_cast<char>(0xFF);
    return out + postscript + preview;
}

} // namespace sample
