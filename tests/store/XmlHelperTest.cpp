#include <gtest/gtest.h>

#include <cstdio>
#include <string>

#include <unistd.h>

#include <wx/log.h>
#include <wx/sstream.h>

#include "XmlHelper.h"

namespace
{
std::unique_ptr<wxXmlDocument> Parse(const char* text)
{
    wxStringInputStream stream(wxString::FromUTF8(text));
    auto document = std::make_unique<wxXmlDocument>();
    EXPECT_TRUE(document->Load(stream));
    return document;
}

// Attribute names and values in document order, "a=1;b=2;".
std::string Attributes(const wxXmlNode* node)
{
    std::string out;
    for (const wxXmlAttribute* a = node->GetAttributes(); a; a = a->GetNext())
        out += (a->GetName() + "=" + a->GetValue() + ";").ToStdString();
    return out;
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
        if (level == wxLOG_Error)
        {
            ++errors;
            last = msg.ToStdString();
        }
    }
};
} // namespace

TEST(XmlFind, DirectChildWinsOverDeeperMatchUnderEarlierSibling)
{
    auto doc = Parse("<r><a><x id='deep'/></a><x id='direct'/></r>");
    wxXmlNode* found = CXmlNodeHelper::Find(doc->GetRoot(), "x", true);
    ASSERT_NE(found, nullptr);
    EXPECT_EQ(found->GetAttribute("id"), "direct");
}

TEST(XmlFind, RecursiveSearchVisitsSiblingsInDocumentOrderDepthFirst)
{
    auto doc = Parse("<r><a><b><x id='a-b'/></b></a><c><x id='c'/></c></r>");
    wxXmlNode* found = CXmlNodeHelper::Find(doc->GetRoot(), "x", true);
    ASSERT_NE(found, nullptr);
    EXPECT_EQ(found->GetAttribute("id"), "a-b");
    EXPECT_EQ(CXmlNodeHelper::Find(doc->GetRoot(), "x", false), nullptr);
}

TEST(XmlFind, MatchesOnlyElementsAndExactCase)
{
    wxXmlNode parent(wxXML_ELEMENT_NODE, "r");
    parent.AddChild(new wxXmlNode(wxXML_TEXT_NODE, "x", "text"));
    parent.AddChild(new wxXmlNode(wxXML_COMMENT_NODE, "x", "comment"));
    parent.AddChild(new wxXmlNode(wxXML_ELEMENT_NODE, "X"));
    EXPECT_EQ(CXmlNodeHelper::Find(&parent, "x", true), nullptr);
    wxXmlNode* element = new wxXmlNode(wxXML_ELEMENT_NODE, "x");
    parent.AddChild(element);
    EXPECT_EQ(CXmlNodeHelper::Find(&parent, "x", true), element);
    EXPECT_EQ(CXmlNodeHelper::Find(nullptr, "x", true), nullptr);
}

TEST(XmlFind, FindNextSkipsOtherNamesAndNonElements)
{
    auto doc = Parse("<r><x id='1'/><y/><!--x--><x id='2'/></r>");
    wxXmlNode* first = CXmlNodeHelper::Find(doc->GetRoot(), "x");
    wxXmlNode* second = CXmlNodeHelper::FindNext(first, "x");
    ASSERT_NE(second, nullptr);
    EXPECT_EQ(second->GetAttribute("id"), "2");
    EXPECT_EQ(CXmlNodeHelper::FindNext(second, "x"), nullptr);
}

template <typename Map> class XmlAttributeMaps : public ::testing::Test
{
};
using MapFlavours = ::testing::Types<StdStrAttributeMap, WxStrAttributeMap>;
TYPED_TEST_SUITE(XmlAttributeMaps, MapFlavours);

TYPED_TEST(XmlAttributeMaps, InsertAddsInKeyOrderAndRefusesEmptyMap)
{
    wxXmlNode node(wxXML_ELEMENT_NODE, "n");
    TypeParam empty;
    EXPECT_FALSE(CXmlNodeHelper::Insert(&node, empty));
    EXPECT_EQ(node.GetAttributes(), nullptr);
    TypeParam map;
    map[L"b"] = L"2";
    map[L"B"] = L"upper"; // code-point order puts upper case first
    map[L"a"] = L"1";
    EXPECT_TRUE(CXmlNodeHelper::Insert(&node, map));
    EXPECT_EQ(Attributes(&node), "B=upper;a=1;b=2;");
}

TYPED_TEST(XmlAttributeMaps, UpdateKeepsPlacesRemovesMissingAppendsNew)
{
    auto doc = Parse("<n z='old' gone='x' a='old'/>");
    wxXmlNode* node = doc->GetRoot();
    TypeParam map;
    map[L"a"] = L"new-a";
    map[L"z"] = L"new-z";
    map[L"m"] = L"added";
    map[L"c"] = L"added-c";
    EXPECT_TRUE(CXmlNodeHelper::Update(node, map));
    EXPECT_EQ(Attributes(node), "z=new-z;a=new-a;c=added-c;m=added;");

    TypeParam empty;
    EXPECT_FALSE(CXmlNodeHelper::Update(node, empty));
    EXPECT_EQ(Attributes(node), "z=new-z;a=new-a;c=added-c;m=added;");
}

TYPED_TEST(XmlAttributeMaps, UpdateCanRemoveTheFirstAndAllOldAttributes)
{
    auto doc = Parse("<n first='1' second='2'/>");
    TypeParam map;
    map[L"only"] = L"v";
    EXPECT_TRUE(CXmlNodeHelper::Update(doc->GetRoot(), map));
    EXPECT_EQ(Attributes(doc->GetRoot()), "only=v;");
}

TYPED_TEST(XmlAttributeMaps, ReadKeepsExistingKeysAndFirstDuplicate)
{
    wxXmlNode node(wxXML_ELEMENT_NODE, "n");
    node.AddAttribute("k", "first");
    node.AddAttribute("k", "second");
    node.AddAttribute("other", "o");
    TypeParam map;
    map[L"other"] = L"kept";
    CXmlNodeHelper::Read(&node, map);
    EXPECT_EQ(map.size(), 2u);
    EXPECT_EQ(map[L"k"], L"first");
    EXPECT_EQ(map[L"other"], L"kept");
}

TYPED_TEST(XmlAttributeMaps, SubNodePropertiesRoundTripWithEmptyValues)
{
    wxXmlNode node(wxXML_ELEMENT_NODE, "n");
    TypeParam written;
    written[L"WIDTH"] = L"612";
    written[L"EMPTY"] = L"";
    written[L"\u00c4NDERUNG"] = L"\u00fc";
    CXmlNodeHelper::SetPropertyAsSubNode(&node, written);
    wxXmlNode* empty = CXmlNodeHelper::Find(&node, "EMPTY");
    ASSERT_NE(empty, nullptr);
    EXPECT_EQ(empty->GetAttributes(), nullptr);
    EXPECT_EQ(CXmlNodeHelper::Find(&node, "WIDTH")->GetAttribute("value"), "612");

    TypeParam read;
    CXmlNodeHelper::GetSubNodesAsProperty(&node, read);
    EXPECT_EQ(read, written);
}

TEST(XmlNodeHelper, RemoveChildrenLeavesNodeEmptyAndUsable)
{
    auto doc = Parse("<r><a><b/></a>text<c/></r>");
    CXmlNodeHelper::RemoveChildren(doc->GetRoot());
    EXPECT_EQ(doc->GetRoot()->GetChildren(), nullptr);
    doc->GetRoot()->AddChild(new wxXmlNode(wxXML_ELEMENT_NODE, "d"));
    EXPECT_NE(CXmlNodeHelper::Find(doc->GetRoot(), "d"), nullptr);
}

TEST(XmlPropertyHelper, CountExactFindAndValueByPosition)
{
    auto doc = Parse("<n a='1' Name='2' name='3'/>");
    wxXmlAttribute* first = doc->GetRoot()->GetAttributes();
    EXPECT_EQ(CXmlPropertyHelper::Count(first), 3u);
    EXPECT_EQ(CXmlPropertyHelper::Count(nullptr), 0u);
    wxXmlAttribute* found = CXmlPropertyHelper::Find(first, L"name");
    ASSERT_NE(found, nullptr);
    EXPECT_EQ(found->GetValue(), "3");
    EXPECT_EQ(CXmlPropertyHelper::Find(first, L"nam"), nullptr);
    // Positions past the end, and an empty list, read as "".
    EXPECT_EQ(CXmlPropertyHelper::ValueAt(first, 1), "2");
    EXPECT_EQ(CXmlPropertyHelper::ValueAt(first, 3), "");
    EXPECT_EQ(CXmlPropertyHelper::ValueAt(nullptr, 0), "");
}

TEST(StdString, NarrowTextIsWidenedThroughTheLocale)
{
    const char* old = setlocale(LC_CTYPE, nullptr);
    const std::string saved = old ? old : "C";
    if (!setlocale(LC_CTYPE, "C.UTF-8"))
        GTEST_SKIP() << "no C.UTF-8 locale";
    EXPECT_EQ(CStdStr<wchar_t>("gr\xc3\xbc\xc3\x9f"), std::wstring(L"gr\u00fc\u00df"));
    EXPECT_EQ(CStdStr<wchar_t>(static_cast<const char*>(nullptr)), std::wstring());
    EXPECT_EQ(CStdStr<wchar_t>(static_cast<const wchar_t*>(nullptr)), std::wstring());
    setlocale(LC_CTYPE, saved.c_str());
}

class XmlLoad : public ::testing::Test
{
protected:
    void SetUp() override
    {
        char pattern[] = "/tmp/hf-xml-XXXXXX";
        ASSERT_NE(mkdtemp(pattern), nullptr);
        m_dir = pattern;
        m_previous = wxLog::SetActiveTarget(&m_log);
    }
    void TearDown() override
    {
        wxLog::SetActiveTarget(m_previous);
        std::remove((m_dir + "/f.xml").c_str());
        rmdir(m_dir.c_str());
    }
    std::string Write(const char* content)
    {
        const std::string path = m_dir + "/f.xml";
        FILE* f = fopen(path.c_str(), "wb");
        fputs(content, f);
        fclose(f);
        return path;
    }
    std::string m_dir;
    CountingLog m_log;
    wxLog* m_previous = nullptr;
};

TEST_F(XmlLoad, MissingFileIsNullWithoutLogging)
{
    EXPECT_EQ(CXmlDocumentHelper::Load(CStdStr<wchar_t>(m_dir + "/none.xml"), L"UTF-8"), nullptr);
    wxLog::FlushActive();
    EXPECT_EQ(m_log.errors, 0);
}

TEST_F(XmlLoad, MalformedFileLogsOnceAndIsNull)
{
    const std::string path = Write("<r><unclosed></r>");
    EXPECT_EQ(CXmlDocumentHelper::Load(CStdStr<wchar_t>(path), L"UTF-8"), nullptr);
    wxLog::FlushActive();
    EXPECT_EQ(m_log.errors, 1);
    EXPECT_EQ(m_log.last, "Cannot load Strings from file '" + path + "'.");
}

TEST_F(XmlLoad, WellFormedFileGivesOwnedDocument)
{
    const std::string path = Write("<?xml version='1.0' encoding='UTF-8'?><r a='\xc3\xa4'/>");
    std::unique_ptr<wxXmlDocument> doc(CXmlDocumentHelper::Load(CStdStr<wchar_t>(path), L"UTF-8"));
    ASSERT_NE(doc, nullptr);
    EXPECT_EQ(doc->GetRoot()->GetAttribute("a"), wxString(L"\u00e4"));
    wxLog::FlushActive();
    EXPECT_EQ(m_log.errors, 0);
}
