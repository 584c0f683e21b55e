#include "CupsQueues.h"

#include <algorithm>
#include <fstream>
#include <memory>
#include <sstream>

#include <unistd.h>

#include <cups/cups.h>
#include <cups/ppd.h>
#include <cups/pwg.h>

#include "PageCode.h"
#include "PpdCapabilities.h"
#include "ServerDescriptionWriter.h"
#include "ServerFromPpd.h"

namespace printing
{
namespace
{
struct IppDeleter
{
    void operator()(ipp_t* ipp) const { ippDelete(ipp); }
};
using IppHandle = std::unique_ptr<ipp_t, IppDeleter>;

std::string LastError()
{
    const char* text = cupsLastErrorString();
    return text && *text ? text : ippErrorString(cupsLastError());
}

std::string StringOf(ipp_t* response, const char* name)
{
    ipp_attribute_t* attribute = ippFindAttribute(response, name, IPP_TAG_ZERO);
    const char* value = attribute ? ippGetString(attribute, 0, nullptr) : nullptr;
    return value ? value : "";
}

// The widest margin the printer can print with; every paper gets it.
double MarginPoints(ipp_t* response, const char* name)
{
    ipp_attribute_t* attribute = ippFindAttribute(response, name, IPP_TAG_INTEGER);
    int widest = 0;
    for (int i = 0; attribute && i < ippGetCount(attribute); ++i)
        widest = std::max(widest, ippGetInteger(attribute, i));
    return PWG_TO_POINTS(widest);
}

// A printer known only by its IPP attributes: its media sizes, with the
// standard page code, since there is no printer code to keep.
bool CapabilitiesFromIpp(ipp_t* response, PpdCapabilities& capabilities)
{
    const double left = MarginPoints(response, "media-left-margin-supported");
    const double bottom = MarginPoints(response, "media-bottom-margin-supported");
    const double right = MarginPoints(response, "media-right-margin-supported");
    const double top = MarginPoints(response, "media-top-margin-supported");
    capabilities.modelName = StringOf(response, "printer-make-and-model");
    ipp_attribute_t* media = ippFindAttribute(response, "media-supported", IPP_TAG_ZERO);
    for (int i = 0; media && i < ippGetCount(media); ++i)
    {
        const char* name = ippGetString(media, i, nullptr);
        pwg_media_t* size = name ? pwgMediaForPWG(name) : nullptr;
        if (!size || size->width <= 0 || size->length <= 0)
            continue;
        const double width = PWG_TO_POINTS(size->width);
        const double height = PWG_TO_POINTS(size->length);
        const std::string pwg = name;
        const bool isMin = pwg.rfind("custom_min_", 0) == 0;
        if (isMin || pwg.rfind("custom_max_", 0) == 0)
        {
            (isMin ? capabilities.custom.minWidth : capabilities.custom.maxWidth) = width;
            (isMin ? capabilities.custom.minHeight : capabilities.custom.maxHeight) = height;
            continue;
        }
        PpdPaper paper;
        paper.keyword = size->ppd ? size->ppd : pwg;
        paper.displayName = paper.keyword;
        paper.pwgName = pwg;
        paper.command = StandardPageSizeCode(width, height);
        paper.width = width;
        paper.height = height;
        paper.left = left;
        paper.bottom = bottom;
        paper.right = width - right;
        paper.top = height - top;
        capabilities.papers.push_back(paper);
    }
    if (capabilities.papers.empty())
        return false;
    pwg_media_t* preferred = pwgMediaForPWG(StringOf(response, "media-default").c_str());
    capabilities.defaultPaper =
        preferred && preferred->ppd ? preferred->ppd : capabilities.papers.front().keyword;
    PpdCustomSize& custom = capabilities.custom;
    custom.allowed = custom.minWidth > 0 && custom.maxWidth >= custom.minWidth;
    custom.left = left;
    custom.bottom = bottom;
    custom.right = right;
    custom.top = top;
    custom.command = kStandardCustomSizeCode;
    return true;
}

// The queue's PPD through the scheduler, or false when it has none.
bool FetchPpd(const std::string& queue, std::string& bytes)
{
    char path[1024] = "";
    time_t modified = 0;
    if (cupsGetPPD3(CUPS_HTTP_DEFAULT, queue.c_str(), &modified, path, sizeof path) !=
        HTTP_STATUS_OK)
        return false;
    std::ifstream in(path, std::ios::binary);
    std::ostringstream content;
    const bool read = in && (content << in.rdbuf());
    unlink(path);
    bytes = content.str();
    return read && !bytes.empty();
}

// Writes bytes to a private temporary file for the PPD parser.
std::string TemporaryCopy(const std::string& bytes)
{
    char path[] = "/tmp/hotfolder-queue-XXXXXX";
    const int fd = mkstemp(path);
    if (fd < 0)
        return std::string();
    const bool written =
        write(fd, bytes.data(), bytes.size()) == static_cast<ssize_t>(bytes.size());
    close(fd);
    if (!written)
    {
        unlink(path);
        return std::string();
    }
    return path;
}
} // namespace

std::string SchedulerName()
{
    const std::string server = cupsServer();
    if (server.empty() || server[0] == '/')
        return server;
    return server + ":" + std::to_string(ippPort());
}

bool ListQueues(std::vector<QueueInfo>& queues, std::string& error)
{
    ipp_t* request = ippNewRequest(IPP_OP_CUPS_GET_PRINTERS);
    static const char* const wanted[] = {"printer-name", "printer-make-and-model"};
    ippAddStrings(request, IPP_TAG_OPERATION, IPP_TAG_KEYWORD, "requested-attributes", 2, nullptr,
                  wanted);
    IppHandle response(cupsDoRequest(CUPS_HTTP_DEFAULT, request, "/"));
    if (cupsLastError() == IPP_STATUS_ERROR_NOT_FOUND)
    {
        queues.clear(); // a scheduler without queues
        return true;
    }
    if (!response || cupsLastError() > IPP_STATUS_OK_CONFLICTING)
    {
        error = LastError();
        return false;
    }
    std::vector<QueueInfo> found;
    QueueInfo current;
    for (ipp_attribute_t* a = ippFirstAttribute(response.get()); a;
         a = ippNextAttribute(response.get()))
    {
        const char* name = ippGetName(a);
        if (!name) // the end of one printer's group
        {
            if (!current.name.empty())
                found.push_back(current);
            current = QueueInfo();
            continue;
        }
        const char* value = ippGetString(a, 0, nullptr);
        if (!value)
            continue;
        if (std::string(name) == "printer-name")
            current.name = value;
        else if (std::string(name) == "printer-make-and-model")
            current.makeAndModel = value;
    }
    if (!current.name.empty())
        found.push_back(current);
    queues = std::move(found);
    return true;
}

QueueLookup QueueServerDescription(const std::string& queue, wxString& xml, std::string& ppdBytes,
                                   std::string& error)
{
    char uri[1024];
    httpAssembleURIf(HTTP_URI_CODING_ALL, uri, sizeof uri, "ipp", nullptr, "localhost", ippPort(),
                     "/printers/%s", queue.c_str());
    ipp_t* request = ippNewRequest(IPP_OP_GET_PRINTER_ATTRIBUTES);
    ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_URI, "printer-uri", nullptr, uri);
    IppHandle response(cupsDoRequest(CUPS_HTTP_DEFAULT, request, "/"));
    if (cupsLastError() == IPP_STATUS_ERROR_NOT_FOUND)
    {
        error = LastError();
        return QueueLookup::UnknownQueue;
    }
    if (!response || cupsLastError() > IPP_STATUS_OK_CONFLICTING)
    {
        error = LastError();
        return QueueLookup::Unreachable;
    }

    std::string bytes;
    if (FetchPpd(queue, bytes))
    {
        const std::string path = TemporaryCopy(bytes);
        const bool made = !path.empty() && ServerDescriptionFromPpd(path, xml, error);
        if (!path.empty())
            unlink(path.c_str());
        if (!made)
        {
            if (error.empty())
                error = "cannot keep a copy of the queue's printer description in /tmp";
            return QueueLookup::Unusable;
        }
        ppdBytes = bytes;
        return QueueLookup::Found;
    }
    PpdCapabilities capabilities;
    if (!CapabilitiesFromIpp(response.get(), capabilities))
    {
        error = "the queue has no printer description and names no media sizes";
        return QueueLookup::Unusable;
    }
    xml = ServerDescriptionXml(capabilities);
    ppdBytes.clear();
    return QueueLookup::Found;
}
} // namespace printing
