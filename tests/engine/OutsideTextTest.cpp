// Outside text shown safely: nothing of it can break a line, and the shown
// text reads back as the original.
#include <gtest/gtest.h>

#include "CaseTable.h"
#include "posix/OutsideText.h"

namespace
{
// "%HH" a byte, "%%" a per cent sign, "-" nothing; "300x" three hundred x.
std::string Decoded(const std::string& text)
{
    if (text == "-")
        return std::string();
    if (text.rfind("300", 0) == 0 && text.size() > 3)
    {
        std::string unit = Decoded(text.substr(3)), out;
        for (int i = 0; i < 300; ++i)
            out += unit;
        return out;
    }
    std::string out;
    for (size_t i = 0; i < text.size(); ++i)
        if (text[i] == '%' && i + 1 < text.size() && text[i + 1] == '%')
            out += text[++i];
        else if (text[i] == '%' && i + 2 < text.size())
        {
            out += static_cast<char>(std::stoi(text.substr(i + 1, 2), nullptr, 16));
            i += 2;
        }
        else
            out += text[i];
    return out;
}
} // namespace

TEST(OutsideText, ShownWithoutLineBreaksAndReadBack)
{
    const std::string prefix = "%%Title: /";
    for (const testkit::CaseFields& row : testkit::Cases("engine/outside-text.txt", 4, 10))
    {
        SCOPED_TRACE(row[3]);
        const std::string raw = Decoded(row[1]);
        if (row[0] == "dsc")
        {
            const std::string value = posix::DscCommentValue(prefix, raw);
            EXPECT_EQ(value.size(), std::stoul(row[2]));
            EXPECT_EQ(value.find_first_of("\r\n"), std::string::npos);
            EXPECT_LE(prefix.size() + value.size(), 255u);
            continue;
        }
        const std::string shown = posix::ShownText(raw);
        EXPECT_EQ(shown, row[2] == "-" ? std::string() : row[2]);
        EXPECT_EQ(shown.find_first_of("\r\n"), std::string::npos);
        std::string back;
        ASSERT_TRUE(posix::ReadShownText(shown, back));
        EXPECT_EQ(back, raw);
    }
    std::string ignored;
    for (const char* malformed : {"a\\", "a\\x4", "a\\xZZ", "a\\q"})
        EXPECT_FALSE(posix::ReadShownText(malformed, ignored)) << malformed;
}
