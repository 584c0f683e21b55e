#include "PpdCapabilities.h"

#include <cstdlib>
#include <cstring>
#include <memory>

#include <cups/ppd.h>
#include <cups/pwg.h>

#include "PageCode.h"

namespace printing
{
namespace
{
struct PpdCloser
{
    void operator()(ppd_file_t* ppd) const { ppdClose(ppd); }
};
using PpdHandle = std::unique_ptr<ppd_file_t, PpdCloser>;

std::string OpenError(const std::string& path)
{
    int line = 0;
    const ppd_status_t status = ppdLastError(&line);
    std::string text = "cannot read the printer description " + path + ": ";
    text += ppdErrorString(status);
    if (status != PPD_FILE_OPEN_ERROR && line > 0)
        text += " on line " + std::to_string(line);
    return text;
}

// The standard name of the keyword, unless the printer uses that keyword
// for another size ("Postcard" is not always the Japanese one): then the
// name of the size itself.
std::string PwgNameOf(const char* keyword, double width, double height)
{
    const int pwgWidth = PWG_FROM_POINTS(width);
    const int pwgLength = PWG_FROM_POINTS(height);
    const int onePoint = PWG_FROM_POINTS(1);
    pwg_media_t* media = pwgMediaForPPD(keyword);
    if (media && media->pwg && std::abs(media->width - pwgWidth) <= onePoint &&
        std::abs(media->length - pwgLength) <= onePoint)
        return media->pwg;
    media = pwgMediaForSize(pwgWidth, pwgLength);
    return media && media->pwg ? media->pwg : std::string();
}

// "600dpi" and "600x1200dpi" both give the first number.
int DefaultResolution(ppd_file_t* ppd)
{
    ppd_attr_t* attr = ppdFindAttr(ppd, "DefaultResolution", nullptr);
    if (!attr || !attr->value)
        return 0;
    return static_cast<int>(std::strtol(attr->value, nullptr, 10));
}

void ReadCustomSize(ppd_file_t* ppd, bool inJclSection, PpdCustomSize& custom)
{
    ppd_attr_t* code = ppdFindAttr(ppd, "CustomPageSize", "True");
    if (!ppd->variable_sizes || !code)
        return;
    custom.allowed = true;
    custom.minWidth = ppd->custom_min[0];
    custom.minHeight = ppd->custom_min[1];
    custom.maxWidth = ppd->custom_max[0];
    custom.maxHeight = ppd->custom_max[1];
    // HWMargins are given as left, bottom, right, top.
    custom.left = ppd->custom_margins[0];
    custom.bottom = ppd->custom_margins[1];
    custom.right = ppd->custom_margins[2];
    custom.top = ppd->custom_margins[3];
    custom.command = code->value ? code->value : "";
    if (!IsPostScriptPageCode(custom.command, inJclSection))
        custom.command = kStandardCustomSizeCode;
    // The filter puts the size's operands straight in front of this code,
    // so it must start with a blank. A space, not the PPD's line break: an
    // XML reader drops a text's leading line break as white-space-only data.
    const size_t codeStart = custom.command.find_first_not_of(" \t\r\n");
    custom.command.erase(0, codeStart == std::string::npos ? custom.command.size() : codeStart);
    if (!custom.command.empty())
        custom.command.insert(0, " ");
}
} // namespace

bool ReadPpdCapabilities(const std::string& ppdPath, PpdCapabilities& capabilities,
                         std::string& error)
{
    PpdHandle ppd(ppdOpenFile(ppdPath.c_str()));
    if (!ppd)
    {
        error = OpenError(ppdPath);
        return false;
    }
    ppd_option_t* pageSize = ppdFindOption(ppd.get(), "PageSize");
    if (!pageSize)
    {
        error = "the printer description " + ppdPath + " offers no PageSize option";
        return false;
    }

    const bool inJclSection = pageSize->section == PPD_ORDER_JCL;
    PpdCapabilities result;
    result.modelName = ppd->nickname ? ppd->nickname : (ppd->modelname ? ppd->modelname : "");
    result.defaultPaper = pageSize->defchoice;
    result.resolution = DefaultResolution(ppd.get());
    for (int i = 0; i < pageSize->num_choices; ++i)
    {
        const ppd_choice_t& choice = pageSize->choices[i];
        // The parser adds a "Custom" choice for custom sizes; those are
        // described by the custom limits instead.
        if (std::strcmp(choice.choice, "Custom") == 0)
            continue;
        ppd_size_t* size = ppdPageSize(ppd.get(), choice.choice);
        if (!size || size->width <= 0 || size->length <= 0)
            continue; // a paper without dimensions cannot be laid out
        PpdPaper paper;
        paper.keyword = choice.choice;
        paper.displayName = choice.text[0] ? choice.text : choice.choice;
        paper.command = choice.code ? choice.code : "";
        if (!IsPostScriptPageCode(paper.command, inJclSection))
            paper.command = StandardPageSizeCode(size->width, size->length);
        paper.width = size->width;
        paper.height = size->length;
        paper.left = size->left;
        paper.bottom = size->bottom;
        paper.right = size->right;
        paper.top = size->top;
        paper.pwgName = PwgNameOf(choice.choice, paper.width, paper.height);
        result.papers.push_back(paper);
    }
    if (result.papers.empty())
    {
        error = "the printer description " + ppdPath + " has no paper with known dimensions";
        return false;
    }
    ReadCustomSize(ppd.get(), inJclSection, result.custom);
    capabilities = std::move(result);
    return true;
}
} // namespace printing
