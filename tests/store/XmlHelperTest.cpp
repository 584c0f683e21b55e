// The XML helpers the configuration readers and writers are built on.
#include <gtest/gtest.h>

#include <sstream>
#include <string>

#include <wx/log.h>
#include <wx/sstream.h>

#include "TestKit.h"
#include "XmlHelper.h"

namespace
{
std::unique_ptr<wxXmlDocument> Parse(const std::string& text)
{
    wxStringInputStream stream(wxString::FromUTF8(text));
    auto document = std::make_unique<wxXmlDocument>();
    EXPECT_TRUE(document->Load(stream)) << text;
    return document;
}

std::string Attributes(const wxXmlNode* node)
{
    std::string out;
    for (const wxXmlAttribute* a = node->GetAttributes(); a; a = a->GetNext())
        out += (a->GetName() + "=" + a->GetValue() + ";").ToStdString();
    return out;
}

WxStrAttributeMap Map(const std::string& text)
{
    WxStrAttributeMap map;
    std::istringstream in(text);
    for (std::string entry; std::getline(in, entry, ';');)
        map[wxString::FromUTF8(entry.substr(0, entry.find('=')))] =
            wxString::FromUTF8(entry.substr(entry.find('=') + 1));
    return map;
}

std::string Id(const wxXmlNode* node)
{
    return node ? node->GetAttribute("id").ToStdString() : "(none)";
}

std::string Apply(const std::string& op, wxXmlNode* root, const std::string& arg)
{
    const std::string name = arg.substr(0, arg.find(' '));
    wxXmlAttribute* attributes = root->GetAttributes();
    if (op == "find")
        return Id(CXmlNodeHelper::Find(root, name, arg.find(" deep") != std::string::npos));
    if (op == "chain")
    {
        std::string ids;
        for (wxXmlNode* n = CXmlNodeHelper::Find(root, name); n;
             n = CXmlNodeHelper::FindNext(n, name))
            ids += (ids.empty() ? "" : ",") + Id(n);
        return ids.empty() ? "(none)" : ids;
    }
    if (op == "update")
    {
        const bool changed = CXmlNodeHelper::Update(root, Map(arg));
        return (changed ? "yes " : "no ") + Attributes(root);
    }
    WxStrAttributeMap map = Map(arg);
    std::string out;
    if (op == "read")
    {
        CXmlNodeHelper::Read(root, map);
        for (const auto& [key, value] : map)
            out += (key + "=" + value + ";").ToStdString();
        return out;
    }
    if (op == "subnodes")
    {
        CXmlNodeHelper::SetPropertyAsSubNode(root, map);
        WxStrAttributeMap read;
        CXmlNodeHelper::GetSubNodesAsProperty(root, read);
        EXPECT_EQ(read, map);
        for (const wxXmlNode* c = root->GetChildren(); c; c = c->GetNext())
            out += (out.empty() ? "" : " ") + c->GetName().ToStdString() + ":" + Attributes(c);
        return out;
    }
    if (op == "count")
        return std::to_string(CXmlPropertyHelper::Count(attributes));
    if (op == "attribute")
    {
        const wxXmlAttribute* found = CXmlPropertyHelper::Find(attributes, CStdStrW(arg));
        return found ? found->GetValue().ToStdString() : "(none)";
    }
    const wxString value = CXmlPropertyHelper::ValueAt(attributes, std::stoul(arg));
    return value.empty() ? "(empty)" : value.ToStdString();
}

// Counts error messages instead of printing them.
class CountingLog : public wxLog
{
public:
    int errors = 0;
    std::string last;

protected:
    void DoLogRecord(wxLogLevel level, const wxString& msg, const wxLogRecordInfo&) override
    {
        errors += level == wxLOG_Error;
        last = msg.ToStdString();
    }
};
} // namespace

TEST(XmlHelper, CasesOfTheTable)
{
    for (const testkit::CaseFields& c : testkit::Cases("store/xml-helper.txt", 5))
    {
        SCOPED_TRACE(c[0] + " | " + c[1] + " | " + c[2]);
        auto document = Parse(c[1]);
        EXPECT_EQ(Apply(c[0], document->GetRoot(), c[2]), c[3]) << c[4];
    }
}

TEST(XmlHelper, FindMatchesElementsOnly)
{
    wxXmlNode parent(wxXML_ELEMENT_NODE, "r");
    parent.AddChild(new wxXmlNode(wxXML_TEXT_NODE, "x", "text"));
    parent.AddChild(new wxXmlNode(wxXML_COMMENT_NODE, "x", "comment"));
    EXPECT_EQ(CXmlNodeHelper::Find(&parent, "x", true), nullptr);
    wxXmlNode* element = new wxXmlNode(wxXML_ELEMENT_NODE, "x");
    parent.AddChild(element);
    EXPECT_EQ(CXmlNodeHelper::Find(&parent, "x", true), element);
    EXPECT_EQ(CXmlNodeHelper::Find(nullptr, "x", true), nullptr);
}

TEST(XmlHelper, NarrowTextIsWidenedThroughTheLocaleBytesItCannotReadKept)
{
    TESTKIT_USE_LOCALE(locale, "C.UTF-8");
    EXPECT_EQ(CStdStrW("gr\xc3\xbc\xc3\x9f"), std::wstring(L"gr\u00fc\u00df"));
    // Not UTF-8: one code point per byte, rather than nothing.
    EXPECT_EQ(CStdStrW("a\xff\xc3"), std::wstring(L"a\u00ff\u00c3"));
    EXPECT_EQ(CStdStrW(""), std::wstring());
    EXPECT_EQ(CStdStrW(static_cast<const char*>(nullptr)), std::wstring());
    EXPECT_EQ(CStdStrW(static_cast<const wchar_t*>(nullptr)), std::wstring());
}

// A missing file is no error; a malformed one is reported once.
TEST(XmlHelper, LoadGivesAnOwnedDocumentOrNull)
{
    testkit::ScratchDir dir;
    CountingLog log;
    wxLog* previous = wxLog::SetActiveTarget(&log);
    EXPECT_EQ(CXmlDocumentHelper::Load(CStdStrW(dir.File("none.xml")), L"UTF-8"), nullptr);
    wxLog::FlushActive();
    EXPECT_EQ(log.errors, 0);

    testkit::WriteFile(dir.File("good.xml"), "<?xml version='1.0'?><r a='\xc3\xa4'/>");
    std::unique_ptr<wxXmlDocument> good(
        CXmlDocumentHelper::Load(CStdStrW(dir.File("good.xml")), L"UTF-8"));
    ASSERT_NE(good, nullptr);
    EXPECT_EQ(good->GetRoot()->GetAttribute("a"), wxString(L"\u00e4"));
    wxLog::FlushActive();
    EXPECT_EQ(log.errors, 0);

    for (const char* bad : {"<r><unclosed></r>", "", "<?xml version='1.0'?>"})
    {
        testkit::WriteFile(dir.File("bad.xml"), bad);
        EXPECT_EQ(CXmlDocumentHelper::Load(CStdStrW(dir.File("bad.xml")), L"UTF-8"), nullptr);
        wxLog::FlushActive();
        EXPECT_EQ(log.last, "Cannot load Strings from file '" + dir.File("bad.xml") + "'.");
    }
    EXPECT_EQ(log.errors, 3);
    wxLog::SetActiveTarget(previous);
}
