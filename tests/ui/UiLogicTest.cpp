// Panel logic that needs no window, over the cases in
// tests/data/ui/logic.txt: enabling rules, range checks, paper lookup, place
// holders and the custom size keystroke filter.
#include <functional>
#include <map>

#include <gtest/gtest.h>
#include <wx/init.h>

#include "CaseTable.h"
#include "ControlNames.h"
#include "EnablingRules.h"
#include "ImageDimensionRange.h"
#include "PageSizeKeys.h"
#include "SizeKeystrokeFilter.h"
#include "UiText.h"

namespace
{
using Args = std::vector<wxString>;

// The final state every control was asked for, in the names' order.
std::string States(const EnableRequests& requests)
{
    std::string out;
    for (const auto& [name, id] : ui_test::ControlNames())
        if (RequestedState(requests, id) >= 0)
            out += (out.empty() ? "" : " ") + name + "=" +
                   std::to_string(RequestedState(requests, id));
    return out;
}

template <typename Rule> std::function<std::string(const Args&)> RuleCase(Rule rule)
{
    return [rule](const Args& a)
    {
        EnableRequests requests;
        rule(requests, a);
        return States(requests);
    };
}

bool On(const wxString& word)
{
    return word == "1";
}
double Number(const wxString& text)
{
    return std::stod(text.ToStdString());
}

// Types `typed` key by key into a field holding `start`, with the caret at
// "^" or at the end.
std::string Typed(const Args& a)
{
    SizeKeystrokeResult result;
    wxString start = a[0] == "-" ? "" : a[0];
    const int caret = start.Find('^');
    start.Replace("^", "");
    result.text = result.lastAccepted = start;
    result.insertion = caret == wxNOT_FOUND ? start.length() : caret;
    for (wxUniChar ch : a[1])
    {
        wxString text = result.text;
        text.insert(result.insertion, 1, ch);
        result = FilterSizeKeystroke(text, result.insertion + 1, a[3], Number(a[2]),
                                     result.lastAccepted);
    }
    return result.text.ToStdString() + " @" + std::to_string(result.insertion);
}

std::vector<stPageAttribute> Sheets()
{
    std::vector<stPageAttribute> sheets(3);
    const char* names[][2] = {{"Letter", "Letter"}, {"A4", "A4 paper"}, {"A4b", "A4 paper"}};
    for (int i = 0; i < 3; ++i)
        sheets[i].PaperName = names[i][0], sheets[i].PaperDisplayName = names[i][1];
    return sheets;
}

std::string Found(const stPageAttribute* sheet)
{
    return sheet ? sheet->PaperName.ToStdString() : "none";
}

const std::map<std::string, std::function<std::string(const Args&)>> kCases = {
    {"custom-size", RuleCase([](EnableRequests& r, const Args& a)
                             { CustomSizeSelectionRule(r, On(a[0]), On(a[1]), On(a[2])); })},
    {"constrain", RuleCase([](EnableRequests& r, const Args& a)
                           { ConstrainSelectionRule(r, On(a[0]), On(a[1]), On(a[2]), On(a[3])); })},
    {"autoscale",
     RuleCase([](EnableRequests& r, const Args& a) { AutoScaleSelectionRule(r, On(a[0])); })},
    {"width-height",
     RuleCase([](EnableRequests& r, const Args& a) { WidthHeightRule(r, On(a[0])); })},
    {"page-and-image",
     RuleCase([](EnableRequests& r, const Args& a) { PageAndImageGroupRule(r, On(a[0])); })},
    {"dimension",
     [](const Args& a)
     {
         const ImageDimensionCheck check = CheckImageDimension(Number(a[0]), a[1]);
         return check.valid ? std::string("valid")
                            : "invalid " + check.rangeText.ToStdString() + " reset " +
                                  check.resetText.ToStdString();
     }},
    {"entry-text",
     [](const Args& a)
     {
         return CustomPageEntryText(Number(a[0]), Number(a[1]), a[2] == "mm" ? UNIT_MM : UNIT_INCH)
             .ToStdString();
     }},
    {"type", Typed},
    {"placeholders",
     [](const Args& a)
     {
         wxString message = a[0];
         ReplacePlaceHolderString(message, wxSplit(a[1], ','), wxSplit(a[2], ','));
         return message.ToStdString();
     }},
    {"sheet-by-display",
     [](const Args& a) { return Found(FindSheetByDisplayName(Sheets(), a[0])); }},
    {"sheet-by-name", [](const Args& a) { return Found(FindSheetByPaperName(Sheets(), a[0])); }},
};
} // namespace

TEST(PanelLogic, CasesAsTabled)
{
    const wxInitializer toolkit; // the translation service finds its catalogues through it
    for (const auto& c : testkit::Cases("ui/logic.txt", 4, 40))
    {
        SCOPED_TRACE(c[0] + " | " + c[1] + " | " + c[3]);
        ASSERT_EQ(kCases.count(c[0]), 1u);
        Args args;
        for (size_t start = 0, slash = 0; slash != std::string::npos; start = slash + 3)
            args.push_back(
                wxString::FromUTF8(c[1].substr(start, (slash = c[1].find(" / ", start)) - start)));
        EXPECT_EQ(c[2], kCases.at(c[0])(args));
    }
}
