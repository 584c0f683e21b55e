#pragma once
// Outside text (file names, file contents, configuration values) is data:
// wherever it is shown as text (a PostScript comment, a log line, standard
// error, JSON) it goes through here, so no byte of it can end a line, start
// a record or run as program text.
#include <string>
#include <string_view>

namespace posix
{
// Control characters (C0 and DEL) and bytes that are not UTF-8 become
// "\xHH", a backslash "\\"; everything else stays. Text without any of these
// comes back unchanged. ReadShownText gives the original back.
std::string ShownText(std::string_view raw);
// False when shown was not made by ShownText.
bool ReadShownText(std::string_view shown, std::string& raw);

// The value of a DSC comment line "prefix value": shown as above but with
// backslashes as they are (it is never read back, and a name without
// control characters stays exactly as it was), then cut at a character
// boundary so that the whole line, without its line end, stays within 255
// bytes.
std::string DscCommentValue(std::string_view prefix, std::string_view raw);
} // namespace posix
