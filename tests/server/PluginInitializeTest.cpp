// Every query on the server description, run over the cases in
// tests/data/server/queries.txt: which description, which query, and the
// answer written as "true"/"false" followed by the outputs the query
// changed (nothing when it left them alone).
#include <functional>
#include <map>
#include <sstream>

#include <gtest/gtest.h>

#include "TestKit.h"
#include "db/PluginInitialize.h"

namespace
{
using PI = PluginInitialize;

template <typename... T> std::string Join(const T&... parts)
{
    std::ostringstream text; // the classic locale: "." whatever the process locale
    const char* separator = "";
    ((text << separator << parts, separator = "; "), ...);
    return text.str();
}

std::string Render(const stPageAttribute& p)
{
    return Join(p.PaperName, p.PaperAlias, p.PaperDisplayName, p.Width, p.Height, p.Left, p.Top,
                p.Right, p.Bottom, p.PSCommand, p.Reserved1);
}

std::string Render(const stCustomPageSizeAttribute& c)
{
    return Join(c.MinMediaWidth, c.MaxMediaWidth, c.MinMediaHeight, c.MaxMediaHeight,
                c.LeftHWMargin, c.RightHWMargin, c.TopHWMargin, c.BottomHWMargin, c.command,
                c.SubstrateHeightToLength);
}

std::string Answer(bool found, const std::string& before, const std::string& after)
{
    const std::string shown = after.empty() ? "(empty)" : after;
    return std::string(found ? "true" : "false") + (after == before ? "" : " " + shown);
}

// Runs a query on outputs that start as `start` and renders the answer.
template <typename T, typename Query>
std::string Run(T start, Query query, std::function<std::string(const T&)> render)
{
    const std::string before = render(start);
    const bool found = query(start);
    return Answer(found, before, render(start));
}

using QueryFn = std::function<std::string(const wxString& xml, const std::string& argument)>;

std::string Text(const wxString& s)
{
    return s.ToStdString(wxConvUTF8);
}
std::string Pair(const wxString& a, const wxString& b)
{
    return Text(a) + " = " + Text(b);
}

template <typename Flag> QueryFn FlagQuery(Flag flag)
{
    return [flag](const wxString& xml, const std::string&) { return Answer(flag(xml), "", ""); };
}

template <typename Search> QueryFn OptionQuery(Search search)
{
    return [search](const wxString& xml, const std::string&)
    {
        wxString option = "unchanged", value = "unchanged";
        const std::string before = Pair(option, value);
        const bool found = search(xml, option, value);
        return Answer(found, before, Pair(option, value));
    };
}

template <typename Read> QueryFn TextQuery(Read read)
{
    return [read](const wxString& xml, const std::string&)
    {
        return Run<wxString>(
            "sentinel", [&](wxString& out) { return read(xml, out); }, Text);
    };
}

const std::map<std::string, QueryFn>& Queries()
{
    static const std::map<std::string, QueryFn> queries = {
        {"strict-GA2", FlagQuery(&PI::IsServerGA2Enabled)},
        {"strict-GA1", FlagQuery(&PI::IsServerGA1Enabled)},
        {"strict-XRX", FlagQuery(&PI::IsServerXRXEnabled)},
        {"strict-VDP", FlagQuery(&PI::IsServerVDPEnabled)},
        {"strict-OneBitTiff", FlagQuery(&PI::IsServerOneBitTiffEnabled)},
        {"xerox", FlagQuery(&PI::IsXeroxServer)},
        {"feature", [](const wxString& xml, const std::string& name)
         { return Answer(PI::IsFeatureEnabled(xml, wxString::FromUTF8(name)), "", ""); }},
        {"version", [](const wxString& xml, const std::string& required)
         { return Answer(PI::IsRequiredServerVersion(xml, std::stoi(required)), "", ""); }},
        {"resolution",
         [](const wxString& xml, const std::string&)
         {
             return Run<int>(
                 -5, [&](int& dpi) { return PI::InitializeResolution(xml, dpi); },
                 [](const int& dpi) { return std::to_string(dpi); });
         }},
        {"unit", TextQuery(&PI::InitializePreferenceUnit)},
        {"os-unit", TextQuery(&PI::InitializeOSUnit)},
        {"separator", TextQuery(&PI::InitializeDecimalSeparator)},
        {"screen", OptionQuery(&PI::InitializeEngineScreenInfo)},
        {"compression", OptionQuery(&PI::InitializeImageCompressionInfo)},
        {"resolutions", OptionQuery(&PI::InitializeResolutionInfo)},
        // The list starts with a record of the host's own, named "kept".
        {"sheets",
         [](const wxString& xml, const std::string& index)
         {
             std::vector<stPageAttribute> start(1);
             start[0].PaperName = "kept";
             return Run<std::vector<stPageAttribute>>(
                 start, [&](auto& sheets) { return PI::InitializeSheetInfo(xml, sheets); },
                 [&](const std::vector<stPageAttribute>& sheets)
                 {
                     if (!index.empty())
                         return std::stoul(index) < sheets.size()
                                    ? Render(sheets[std::stoul(index)])
                                    : std::string("none");
                     std::string names;
                     for (const auto& sheet : sheets)
                         names += (names.empty() ? "" : ", ") + Text(sheet.PaperName);
                     return names;
                 });
         }},
        {"default-sheet",
         [](const wxString& xml, const std::string&)
         {
             stPageAttribute start;
             start.PaperName = "before";
             start.Width = 1;
             return Run<stPageAttribute>(
                 start, [&](auto& page) { return PI::InitializeDefaultSheetInfo(xml, page); },
                 [](const stPageAttribute& page) { return Render(page); });
         }},
        {"custom",
         [](const wxString& xml, const std::string&)
         {
             stCustomPageSizeAttribute start;
             start.MinMediaWidth = 5;
             start.LeftHWMargin = 99;
             start.command = "kept";
             start.SubstrateHeightToLength = true;
             return Run<stCustomPageSizeAttribute>(
                 start, [&](auto& info) { return PI::InitializeCustomPageSizeInfo(xml, info); },
                 [](const stCustomPageSizeAttribute& info) { return Render(info); });
         }},
    };
    return queries;
}

// "server-full.xml" is a file under tests/data/server, "NAME=text" a
// description holding only that element, "text:..." a text as it stands.
wxString Description(const std::string& source)
{
    if (source.rfind("text:", 0) == 0)
        return wxString::FromUTF8(source.substr(5));
    const size_t equals = source.find('=');
    if (equals == std::string::npos)
        return wxString::FromUTF8(
            testkit::ReadFile(std::string(HF_TEST_DATA_DIR) + "/server/" + source));
    const std::string name = source.substr(0, equals);
    return wxString::FromUTF8(
        "<?xml version=\"1.0\" encoding=\"UTF-8\"?><ServerDescription><Info><" + name + ">" +
        source.substr(equals + 1) + "</" + name + "></Info></ServerDescription>");
}

// Every query, by name, that did not refuse with its outputs untouched.
std::string Answering(const wxString& xml)
{
    std::string names;
    for (const auto& [name, query] : Queries())
        if (query(xml, name == "version" ? "0" : name == "feature" ? "Resolution" : "") != "false")
            names += (names.empty() ? "" : ", ") + name;
    return names.empty() ? "none" : names;
}

void RunTable()
{
    const auto cases = testkit::ReadCaseTable("server/queries.txt");
    ASSERT_GT(cases.size(), 50u);
    for (const auto& fields : cases)
    {
        ASSERT_GE(fields.size(), 4u) << fields[0];
        const std::string& source = fields[0];
        std::istringstream call(fields[1]);
        std::string name, argument;
        call >> name >> argument;
        SCOPED_TRACE(source + " | " + fields[1] + " | " + fields[3]);
        const wxString xml = Description(source);
        if (name == "answering")
        {
            EXPECT_EQ(fields[2], Answering(xml));
            continue;
        }
        ASSERT_EQ(1u, Queries().count(name));
        EXPECT_EQ(fields[2], Queries().at(name)(xml, argument));
    }
}
} // namespace

TEST(ServerDescription, QueriesAnswerAsTabled)
{
    RunTable();
}

// Numbers in the description always use "." whatever the process locale.
TEST(ServerDescription, QueriesAnswerAlikeUnderDecimalCommaLocale)
{
    TESTKIT_USE_LOCALE(german, "de_DE.UTF-8");
    RunTable();
}
