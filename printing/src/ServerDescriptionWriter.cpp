#include "ServerDescriptionWriter.h"

#include <cmath>

#include <wx/mstream.h>
#include <wx/xml/xml.h>

#include "PageCode.h"

namespace printing
{
namespace
{
wxString Number(double value)
{
    return wxString::FromAscii(PointsNumber(value).c_str());
}

// The PPD parser hands texts over as UTF-8; a file that lies about its
// encoding still gives readable Latin-1 rather than nothing.
wxString Text(const std::string& text)
{
    wxString converted = wxString::FromUTF8(text.data(), text.size());
    if (converted.empty() && !text.empty())
        converted = wxString(text.data(), wxConvISO8859_1, text.size());
    return converted;
}

wxXmlNode* AddElement(wxXmlNode* parent, const wxString& name, const wxString& text)
{
    auto* element = new wxXmlNode(wxXML_ELEMENT_NODE, name);
    // An empty element has no child, which the queries read as "absent".
    if (!text.empty())
        element->AddChild(new wxXmlNode(wxXML_TEXT_NODE, wxString(), text));
    parent->AddChild(element);
    return element;
}

void AddPaperGroup(wxXmlNode* parent, const PpdPaper& paper)
{
    AddElement(parent, "PaperName", Text(paper.keyword));
    AddElement(parent, "PaperAlias", Text(paper.pwgName));
    AddElement(parent, "PaperDisplayName", Text(paper.displayName));
    // Left, Top, Right, Bottom carry the imageable box's lower-left x,
    // lower-left y, upper-right x, upper-right y: the order in which the
    // settings panel reads them into the converter's imageable area.
    AddElement(parent, "Left", Number(paper.left));
    AddElement(parent, "Top", Number(paper.bottom));
    AddElement(parent, "Right", Number(paper.right));
    AddElement(parent, "Bottom", Number(paper.top));
    AddElement(parent, "Width", Number(paper.width));
    AddElement(parent, "Height", Number(paper.height));
    AddElement(parent, "PSCommand", Text(paper.command));
}

const PpdPaper& DefaultPaper(const PpdCapabilities& capabilities)
{
    for (const PpdPaper& paper : capabilities.papers)
        if (paper.keyword == capabilities.defaultPaper)
            return paper;
    return capabilities.papers.front();
}

// Metric users get millimetres: the default paper tells where the printer is sold.
wxString UnitOf(const PpdPaper& paper)
{
    const std::string& name = paper.pwgName;
    const bool metric = name.rfind("iso_", 0) == 0 || name.rfind("jis_", 0) == 0 ||
                        name.rfind("jpn_", 0) == 0 || name.rfind("prc_", 0) == 0;
    return metric ? "mm" : "inch";
}

void AddCustomSize(wxXmlNode* parent, const PpdCustomSize& custom)
{
    wxXmlNode* info = AddElement(parent, "CustomPageSizeInfo", wxString());
    AddElement(info, "MinMediaWidth", Number(custom.minWidth));
    AddElement(info, "MaxMediaWidth", Number(custom.maxWidth));
    AddElement(info, "MinMediaHeight", Number(custom.minHeight));
    AddElement(info, "MaxMediaHeight", Number(custom.maxHeight));
    // The reader takes whole points for the margins; round up so the
    // imageable area never reaches into the unprintable edge.
    AddElement(info, "LeftHWMargin", Number(std::ceil(custom.left)));
    AddElement(info, "RightHWMargin", Number(std::ceil(custom.right)));
    AddElement(info, "TopHWMargin", Number(std::ceil(custom.top)));
    AddElement(info, "BottomHWMargin", Number(std::ceil(custom.bottom)));
    AddElement(info, "command", Text(custom.command));
    AddElement(info, "SubstrateHeightToLength", "0");
}
} // namespace

wxString ServerDescriptionXml(const PpdCapabilities& capabilities)
{
    auto* root = new wxXmlNode(wxXML_ELEMENT_NODE, "ServerDescription");
    AddElement(root, "ServerName", Text(capabilities.modelName));
    AddElement(root, "GA2_HOTFOLDERS", "yes");
    AddElement(root, "HF_EPS_FILTER", "yes");
    // Page sizes travel as job options, so the filter must write them.
    AddElement(root, "SubstrateFamilySupported", "no");
    if (capabilities.resolution > 0)
        AddElement(root, "Resolution", Number(capabilities.resolution));
    if (!capabilities.papers.empty())
    {
        AddElement(root, "Units", UnitOf(DefaultPaper(capabilities)));
        AddElement(root, "DecimalSeparator", ".");
        wxXmlNode* sheets = AddElement(root, "SheetInfo", wxString());
        for (const PpdPaper& paper : capabilities.papers)
            AddPaperGroup(sheets, paper);
        wxXmlNode* defaultSheet = AddElement(root, "DefaultPPDPageSize", wxString());
        AddPaperGroup(defaultSheet, DefaultPaper(capabilities));
    }
    if (capabilities.custom.allowed)
        AddCustomSize(root, capabilities.custom);

    wxXmlDocument document;
    document.SetRoot(root);
    document.SetFileEncoding("UTF-8");
    wxMemoryOutputStream out;
    document.Save(out, 2);
    const size_t size = out.GetSize();
    std::string bytes(size, '\0');
    out.CopyTo(bytes.data(), size);
    return wxString::FromUTF8(bytes.data(), bytes.size());
}
} // namespace printing
