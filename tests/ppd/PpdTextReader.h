#pragma once
// A second, deliberately simple reading of a PPD file's text, independent of
// the CUPS parser: what the tests expect comes from here, what the code
// under test produces comes from libcups.
#include <map>
#include <regex>
#include <sstream>
#include <string>
#include <vector>

#include "GhostscriptOracle.h"

namespace ppd_text
{
struct Paper
{
    std::string keyword;
    std::string translation;
    std::string code;
    bool hasDimension = false;
    double width = 0, height = 0;
    bool hasArea = false;
    double llx = 0, lly = 0, urx = 0, ury = 0;
};

struct Description
{
    std::vector<Paper> papers; // PageSize choices in file order
    std::string defaultPageSize;
    bool pageSizeInJcl = false; // "*JCLOpenUI *PageSize"
    bool customAllowed = false;
    std::string customCode;
    double minWidth = 0, maxWidth = 0, minHeight = 0, maxHeight = 0;
    double margins[4] = {0, 0, 0, 0}; // left bottom right top
};

inline std::string Latin1ToUtf8(const std::string& in)
{
    std::string out;
    for (unsigned char c : in)
    {
        if (c < 0x80)
            out += static_cast<char>(c);
        else
        {
            out += static_cast<char>(0xC0 | (c >> 6));
            out += static_cast<char>(0x80 | (c & 0x3F));
        }
    }
    return out;
}

inline std::vector<double> Numbers(const std::string& text)
{
    std::vector<double> numbers;
    std::istringstream in(text);
    in.imbue(std::locale::classic());
    for (double value; in >> value;)
        numbers.push_back(value);
    return numbers;
}

// Whether a page code is PostScript that the job itself may carry: not in the
// JCL section, not printer job language (hex "<1B>" as the PPD writes it).
inline bool IsPostScriptCode(const Description& d, const std::string& code)
{
    return !d.pageSizeInJcl && code.find("@PJL") == std::string::npos &&
           code.find("<1B>%-12345X") == std::string::npos;
}

inline Paper& PaperFor(Description& d, const std::string& keyword)
{
    for (Paper& paper : d.papers)
        if (paper.keyword == keyword)
            return paper;
    static Paper unused;
    unused = Paper();
    return unused;
}

// Reads "*Main Option/Translation: value" entries; a quoted value may span
// lines up to its closing quote.
inline bool Read(const std::string& path, Description& d)
{
    if (access(path.c_str(), R_OK) != 0)
        return false;
    const std::string text = testkit::ReadFile(path);
    const bool latin1 = text.find("*LanguageEncoding: ISOLatin1") != std::string::npos;

    static const std::regex entry(
        R"(^\*([A-Za-z0-9]+)(?:[ \t]+([^/:]+?)(?:/([^:\r\n]*))?)?:[ \t]*)");
    size_t at = 0;
    std::vector<std::pair<std::string, std::string>> pageSizeText; // keyword, translation
    while (at < text.size())
    {
        size_t end = text.find('\n', at);
        if (end == std::string::npos)
            end = text.size();
        const std::string line = text.substr(at, end - at);
        std::smatch m;
        if (!std::regex_search(line, m, entry))
        {
            at = end + 1;
            continue;
        }
        const std::string main = m[1], option = m[2], translation = m[3];
        std::string value;
        const size_t valueStart = at + m.length(0);
        if (valueStart < text.size() && text[valueStart] == '"')
        {
            const size_t close = text.find('"', valueStart + 1);
            value = text.substr(valueStart + 1, close - valueStart - 1);
            end = text.find('\n', close);
            if (end == std::string::npos)
                end = text.size();
        }
        else
        {
            value = line.substr(m.length(0));
            while (!value.empty() && (value.back() == '\r' || value.back() == ' '))
                value.pop_back();
        }
        at = end + 1;

        if (main == "PageSize")
        {
            Paper paper;
            paper.keyword = option;
            paper.translation = latin1 ? Latin1ToUtf8(translation) : translation;
            if (paper.translation.empty())
                paper.translation = option;
            paper.code = value;
            d.papers.push_back(paper);
        }
        else if (main == "JCLOpenUI" && option == "*PageSize")
            d.pageSizeInJcl = true;
        else if (main == "DefaultPageSize")
            d.defaultPageSize = value;
        else if (main == "PaperDimension")
        {
            const auto n = Numbers(value);
            Paper& paper = PaperFor(d, option);
            if (n.size() == 2)
            {
                paper.hasDimension = true;
                paper.width = n[0];
                paper.height = n[1];
            }
        }
        else if (main == "ImageableArea")
        {
            const auto n = Numbers(value);
            Paper& paper = PaperFor(d, option);
            if (n.size() == 4)
            {
                paper.hasArea = true;
                paper.llx = n[0];
                paper.lly = n[1];
                paper.urx = n[2];
                paper.ury = n[3];
            }
        }
        else if (main == "CustomPageSize" && option == "True")
        {
            d.customAllowed = true;
            d.customCode = value;
        }
        else if (main == "ParamCustomPageSize" && (option == "Width" || option == "Height"))
        {
            // "1 points 216 612": order, unit, minimum, maximum
            std::istringstream words(value);
            std::string order, unit;
            double low = 0, high = 0;
            words >> order >> unit >> low >> high;
            (option == "Width" ? d.minWidth : d.minHeight) = low;
            (option == "Width" ? d.maxWidth : d.maxHeight) = high;
        }
        else if (main == "MaxMediaWidth" || main == "MaxMediaHeight")
        {
            const auto n = Numbers(value);
            if (n.size() == 1)
                (main == "MaxMediaWidth" ? d.maxWidth : d.maxHeight) = n[0];
        }
        else if (main == "HWMargins")
        {
            const auto n = Numbers(value);
            for (size_t i = 0; i < 4 && i < n.size(); ++i)
                d.margins[i] = n[i];
        }
    }
    return true;
}
} // namespace ppd_text
