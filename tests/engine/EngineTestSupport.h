#pragma once
// What the engine tests share besides the test kit: EPS files written on the
// fly, conversion records spelt as words, and input fingerprints.
#include <sys/stat.h>
#include <unistd.h>

#include <cstring>
#include <locale>
#include <sstream>
#include <string>

#include <gtest/gtest.h>

#include "EPStoPS.h"
#include "TestKit.h"

namespace hf_test
{
// A number as PostScript writes it, whatever locale a test switched to.
inline std::string Num(double value)
{
    std::ostringstream text;
    text.imbue(std::locale::classic());
    text.precision(17);
    text << value;
    return text.str();
}

// Table text to bytes: \n \r \t \0 \\ and \xHH.
inline std::string Unescape(const std::string& text)
{
    std::string bytes;
    for (size_t i = 0; i < text.size(); ++i)
    {
        if (text[i] != '\\' || i + 1 == text.size())
        {
            bytes += text[i];
            continue;
        }
        const char c = text[++i];
        if (c == 'x')
        {
            bytes += static_cast<char>(std::stoi(text.substr(i + 1, 2), nullptr, 16));
            i += 2;
        }
        else
            bytes += c == 'n' ? '\n' : c == 'r' ? '\r' : c == 't' ? '\t' : c == '0' ? '\0' : c;
    }
    return bytes;
}

// An EPS program that fills exactly its bounding box.
inline std::string FilledBoxEps(double llx, double lly, double urx, double ury)
{
    const std::string l = Num(llx), b = Num(lly), r = Num(urx), t = Num(ury);
    return "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: " + l + " " + b + " " + r + " " + t +
           "\n%%EndComments\nnewpath " + l + " " + b + " moveto " + r + " " + b + " lineto " + r +
           " " + t + " lineto " + l + " " + t + " lineto closepath fill\n%%EOF\n";
}

// The 30-byte DOS EPS binary header with the PostScript section's place.
inline std::string DosEpsHeader(uint32_t offset, uint32_t length)
{
    std::string header = "\xC5\xD0\xD3\xC6";
    for (uint32_t value : {offset, length, 0u, 0u, 0u, 0u})
        for (int i = 0; i < 4; ++i)
            header += static_cast<char>((value >> (8 * i)) & 0xFF);
    return header + "\xFF\xFF"; // checksum
}

// A file column of the engine's tables as bytes: text with the escapes of
// Unescape, {dos OFFSET LENGTH} a DOS EPS binary header, {N*TEXT} TEXT N
// times, {pad N} blanks up to byte N.
inline std::string FileBytes(const std::string& description)
{
    std::string bytes;
    for (size_t at = 0; at < description.size();)
    {
        const size_t open = description.find('{', at);
        bytes += Unescape(description.substr(at, open - at));
        if (open == std::string::npos)
            break;
        const size_t close = description.find('}', open);
        const std::string inner = description.substr(open + 1, close - open - 1);
        std::istringstream words(inner);
        std::string word;
        words >> word;
        if (word == "dos")
        {
            uint32_t offset = 0, length = 0;
            words >> offset >> length;
            bytes += DosEpsHeader(offset, length);
        }
        else if (word == "pad")
        {
            size_t size = 0;
            words >> size;
            bytes.resize(size, ' ');
        }
        else
        {
            const size_t star = inner.find('*');
            const std::string piece = Unescape(inner.substr(star + 1));
            for (long n = std::stol(inner.substr(0, star)); n > 0; --n)
                bytes += piece;
        }
        at = close + 1;
    }
    return bytes;
}

// The input a file column names: "@folder" the scratch folder itself,
// "@missing" a file that is not there, else in.eps written anew with the
// column's bytes. Empty when the bytes could not be written.
inline std::string TableInput(const testkit::ScratchDir& scratch, const std::string& column)
{
    if (column == "@folder")
        return scratch.Path();
    if (column == "@missing")
        return scratch.File("missing.eps");
    const std::string input = scratch.File("in.eps");
    unlink(input.c_str());
    return testkit::WriteFile(input, FileBytes(column)) ? input : std::string();
}

// A conversion record from words separated by "; ": "page W H", "area LLX
// LLY URX URY", "pos N", "size W H", "auto" (custom size, scaled), "fit",
// "shrink", "width" or "height" (proportions kept from that side), "spd TEXT".
// The record points into spd, which must outlive it.
inline EPStoPSparams_t Params(const std::string& words, std::string& spd)
{
    EPStoPSparams_t p;
    std::memset(&p, 0, sizeof p);
    std::istringstream items(words);
    items.imbue(std::locale::classic());
    for (std::string item; std::getline(items, item, ';');)
    {
        std::istringstream in(item);
        in.imbue(std::locale::classic());
        std::string word;
        in >> word;
        if (word == "page")
            in >> p.pageWidth >> p.pageHeight;
        else if (word == "area")
            in >> p.imageableLLX >> p.imageableLLY >> p.imageableURX >> p.imageableURY;
        else if (word == "pos")
            in >> p.imagePosition;
        else if (word == "size")
            in >> p.imageWidth >> p.imageHeight;
        else if (word == "auto")
            p.customSize = p.autoScale = true;
        else if (word == "fit")
            p.fitToPage = true;
        else if (word == "shrink")
            p.shrinkToFit = true;
        else if (word == "width")
            p.constrainProportions = p.widthGiven = true;
        else if (word == "height")
            p.constrainProportions = p.heightGiven = true;
        else if (word == "spd")
        {
            std::getline(in >> std::ws, spd);
            p.setPageDeviceString = spd.data();
        }
        else if (!word.empty())
            ADD_FAILURE() << "unknown option " << word;
    }
    return p;
}

// Size, modification time and content: an input file must never change.
inline std::string Fingerprint(const std::string& path)
{
    struct stat info;
    if (stat(path.c_str(), &info) != 0)
        return "missing";
    return std::to_string(info.st_size) + "@" + std::to_string(info.st_mtim.tv_sec) + "." +
           std::to_string(info.st_mtim.tv_nsec) + ":" + testkit::ReadFile(path);
}

// Detects and converts in one go; the result of ConvertEPStoPS, or -1 when
// the file was not recognised.
inline int DetectAndConvert(const std::string& input, const EPStoPSparams_t& params,
                            const std::string& output)
{
    void* context = nullptr;
    if (IsThisEPS(input.c_str(), &context) != 1)
        return -1;
    return ConvertEPStoPS(&context, &params, output.c_str());
}
} // namespace hf_test
