#include "PostScriptWrapper.h"

#include <cmath>
#include <cstdio>
#include <ctime>
#include <vector>

#include "posix/CLocale.h"
#include "posix/OutsideText.h"

namespace
{
const char kHeaderTemplate[] = "%%!PS-Adobe-3.0\r\n"
                               "%% EPS file converted to PostScript\r\n"
                               "%%%%Title: %s\r\n"
                               "%%%%Creator: Orvane\r\n"
                               "%%%%CreationDate: %s\r\n"
                               "%%%%Pages: 1\r\n"
                               "%%%%BoundingBox: %g %g %g %g\r\n"
                               "%%%%HiResBoundingBox: %g %g %g %g\r\n"
                               "%%%%Orientation: %s\r\n"
                               "%%%%EndComments\r\n"
                               "%%%%BeginSetup\r\n"
                               "userdict /RvLandscapeSetup known\r\n"
                               "{ %d userdict /RvLandscapeSetup get exec }\r\n"
                               "if\r\n"
                               "userdict /VomalXJdict known\r\n"
                               "{ 1 true VomalXJdict /OrvDoing_N_Up get exec }\r\n"
                               "if\r\n"
                               "%s\r\n"
                               "%%%%EndSetup\r\n"
                               "%%%%BeginPageSetup\r\n"
                               "%g %g translate\r\n"
                               "%g rotate\r\n"
                               "%g %g scale\r\n"
                               "%%%%EndPageSetup\r\n"
                               "%%%%Page: 1 1\r\n"
                               "save\r\n"
                               "5 dict begin\r\n"
                               "/@ST_save exch def\r\n"
                               "/@ST_countdictstack countdictstack def\r\n"
                               "/@ST_count count 1 sub def\r\n"
                               "userdict begin\r\n"
                               "/showpage {} def\r\n"
                               "0 setgray\r\n"
                               "0 setlinecap\r\n"
                               "1 setlinewidth\r\n"
                               "0 setlinejoin\r\n"
                               "10 setmiterlimit\r\n"
                               "[] 0 setdash\r\n"
                               "newpath\r\n"
                               "false setstrokeadjust\r\n"
                               "false setoverprint\r\n"
                               "%g %g translate\r\n"
                               "%%%%BeginDocument: %s\r\n";

const char kTrailer[] = "%%EndDocument\r\n"
                        "count @ST_count sub\r\n"
                        "{ pop }\r\n"
                        "repeat\r\n"
                        "countdictstack @ST_countdictstack sub\r\n"
                        "{ end }\r\n"
                        "repeat\r\n"
                        "@ST_save\r\n"
                        "end\r\n"
                        "restore\r\n"
                        "showpage\r\n"
                        "%%Trailer\r\n"
                        "%%EOF\r\n";

const char kNoSetPageDevice[] = "% No setpagedevice string specified\r\n";

// A negative zero would print as "-0".
double Printable(double value)
{
    return value == 0 ? 0.0 : value;
}

template <typename... Args> std::string Format(const char* format, Args... args)
{
    posix::CLocaleScope cLocale;
    const int length = std::snprintf(nullptr, 0, format, args...);
    if (length < 0)
        return std::string();
    std::vector<char> text(static_cast<size_t>(length) + 1);
    std::snprintf(text.data(), text.size(), format, args...);
    return std::string(text.data(), static_cast<size_t>(length));
}
} // namespace

std::string FormatWrapperHeader(const char* docName, const char* creationDate,
                                const PageLayout& layout, const char* setPageDevice)
{
    const PageLayout& l = layout;
    // The name is the dropper's text: it must not end the comment line.
    const std::string title = posix::DscCommentValue("%%Title: ", docName);
    const std::string document = posix::DscCommentValue("%%BeginDocument: ", docName);
    return Format(kHeaderTemplate, title.c_str(), creationDate, Printable(std::floor(l.left)),
                  Printable(std::floor(l.bottom)), Printable(std::ceil(l.right)),
                  Printable(std::ceil(l.top)), Printable(l.left), Printable(l.bottom),
                  Printable(l.right), Printable(l.top), l.rotated ? "Landscape" : "Portrait",
                  l.rotated ? 1 : 0, setPageDevice ? setPageDevice : kNoSetPageDevice,
                  Printable(l.translateX), Printable(l.translateY), Printable(l.angle),
                  Printable(l.scaleX), Printable(l.scaleY), Printable(l.originX),
                  Printable(l.originY), document.c_str());
}

const char* WrapperTrailer()
{
    return kTrailer;
}

std::string CurrentCreationDate()
{
    const time_t now = time(nullptr);
    struct tm local;
    char text[32] = "";
    if (localtime_r(&now, &local))
    {
        // AM and PM in English whatever the locale, like the rest of the header.
        posix::CLocaleScope cLocale;
        strftime(text, sizeof text, "%m/%d/%y %I:%M %p", &local);
    }
    return text;
}
