#pragma once
#include <cstring>
#include <cwchar>
#include <string>
#include <utility>

// The wide string type of the older client code: a std::basic_string with
// extra constructors from narrow text. Narrow text is widened through the
// current C locale's multibyte conversion (not byte by byte); a null narrow
// pointer gives the empty string.
template <typename CT> class CStdStr : public std::basic_string<CT>
{
public:
    using Base = std::basic_string<CT>;
    using Base::Base;

    CStdStr() = default;
    CStdStr(const Base& other) : Base(other) {}
    CStdStr(Base&& other) : Base(std::move(other)) {}
    CStdStr(const CT* text) : Base(text ? text : EmptyText()) {}
    CStdStr(const char* narrow) : Base(Widen(narrow)) {}
    CStdStr(const std::string& narrow) : Base(Widen(narrow.c_str())) {}

private:
    static const CT* EmptyText()
    {
        static const CT empty[1] = {0};
        return empty;
    }
    static Base Widen(const char* narrow);
};

template <> inline std::wstring CStdStr<wchar_t>::Widen(const char* narrow)
{
    if (!narrow)
        return std::wstring();
    std::mbstate_t state{};
    const char* source = narrow;
    const size_t length = std::mbsrtowcs(nullptr, &source, 0, &state);
    if (length == static_cast<size_t>(-1))
    {
        // Not valid in the current locale: keep each byte as its own code
        // point rather than losing the text.
        std::wstring bytes;
        for (const char* p = narrow; *p; ++p)
            bytes.push_back(static_cast<wchar_t>(static_cast<unsigned char>(*p)));
        return bytes;
    }
    std::wstring wide(length, L'\0');
    state = std::mbstate_t{};
    source = narrow;
    std::mbsrtowcs(&wide[0], &source, length, &state);
    return wide;
}

using CStdStrW = CStdStr<wchar_t>;
