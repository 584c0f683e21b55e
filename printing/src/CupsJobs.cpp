#include "CupsJobs.h"

#include <cstdio>
#include <cstring>
#include <memory>

#include <cups/cups.h>

namespace printing
{
const char kJobMarkerOption[] = "hotfolder-work-id";

namespace
{
struct IppDeleter
{
    void operator()(ipp_t* ipp) const { ippDelete(ipp); }
};
using Response = std::unique_ptr<ipp_t, IppDeleter>;

struct FileCloser
{
    void operator()(FILE* file) const { std::fclose(file); }
};

bool Failed(const char* what, CupsError& error)
{
    const ipp_status_t status = cupsLastError();
    const char* text = cupsLastErrorString();
    error.reason = std::string(what) + ": " + (text && *text ? text : ippErrorString(status));
    // Only a request the scheduler understood and turned down for good is
    // refused; everything else (no connection, busy, not accepting jobs,
    // authorisation) may pass once someone acts, so the job waits.
    switch (status)
    {
    case IPP_STATUS_ERROR_BAD_REQUEST:
    case IPP_STATUS_ERROR_NOT_FOUND:
    case IPP_STATUS_ERROR_GONE:
    case IPP_STATUS_ERROR_REQUEST_ENTITY:
    case IPP_STATUS_ERROR_DOCUMENT_FORMAT_NOT_SUPPORTED:
    case IPP_STATUS_ERROR_ATTRIBUTES_OR_VALUES:
        error.trouble = CupsTrouble::Refused;
        break;
    default:
        error.trouble = CupsTrouble::Wait;
        // The library keeps one connection and does not make it anew once
        // the scheduler has gone (a restart): the next request opens a new one.
        const std::string server = cupsServer();
        cupsSetServer(server.c_str());
    }
    return false;
}

std::string PrinterUri(const std::string& queue)
{
    char uri[1024];
    httpAssembleURIf(HTTP_URI_CODING_ALL, uri, sizeof uri, "ipp", nullptr, "localhost", 0,
                     "/printers/%s", queue.c_str());
    return uri;
}

Response Request(ipp_t* request)
{
    // As the jobs' owner: the scheduler shows others no job names.
    if (!ippFindAttribute(request, "requesting-user-name", IPP_TAG_NAME))
        ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_NAME, "requesting-user-name", nullptr,
                     cupsUser());
    return Response(cupsDoRequest(CUPS_HTTP_DEFAULT, request, "/"));
}

bool Succeeded(const Response& response)
{
    return response && cupsLastError() <= IPP_STATUS_OK_CONFLICTING;
}

JobEnd EndOf(int state)
{
    switch (state)
    {
    case IPP_JSTATE_COMPLETED:
        return JobEnd::Completed;
    case IPP_JSTATE_ABORTED:
        return JobEnd::Aborted;
    case IPP_JSTATE_CANCELED:
        return JobEnd::Cancelled;
    default:
        return JobEnd::Open;
    }
}

std::string Joined(ipp_attribute_t* attribute)
{
    std::string text;
    for (int i = 0; attribute && i < ippGetCount(attribute); ++i)
    {
        const char* value = ippGetString(attribute, i, nullptr);
        if (value && std::strcmp(value, "none") != 0)
            text += (text.empty() ? "" : ", ") + std::string(value);
    }
    return text;
}

// The jobs of a response, one per attribute group.
std::vector<JobState> JobsOf(ipp_t* response)
{
    std::vector<JobState> jobs;
    JobState job;
    bool incoming = false;
    int documents = -1;
    const auto flush = [&]
    {
        if (job.id > 0)
        {
            job.complete = !incoming && documents != 0;
            jobs.push_back(job);
        }
        job = JobState();
        incoming = false;
        documents = -1;
    };
    for (ipp_attribute_t* a = ippFirstAttribute(response); a; a = ippNextAttribute(response))
    {
        const char* name = ippGetName(a);
        if (!name)
        {
            flush();
            continue;
        }
        if (!std::strcmp(name, "job-id"))
            job.id = ippGetInteger(a, 0);
        else if (!std::strcmp(name, "job-name"))
            job.name = ippGetString(a, 0, nullptr) ? ippGetString(a, 0, nullptr) : "";
        else if (!std::strcmp(name, "job-originating-user-name"))
            job.user = ippGetString(a, 0, nullptr) ? ippGetString(a, 0, nullptr) : "";
        else if (!std::strcmp(name, "job-state"))
            job.end = EndOf(ippGetInteger(a, 0));
        else if (!std::strcmp(name, "job-state-reasons"))
        {
            job.reasons = Joined(a);
            for (int i = 0; i < ippGetCount(a); ++i)
                incoming = incoming || !std::strcmp(ippGetString(a, i, nullptr), "job-incoming");
        }
        else if (!std::strcmp(name, "job-printer-state-message"))
        {
            const char* message = ippGetString(a, 0, nullptr);
            if (message && *message && job.reasons.find(message) == std::string::npos)
                job.reasons += (job.reasons.empty() ? "" : ": ") + std::string(message);
        }
        else if (!std::strcmp(name, "number-of-documents"))
            documents = ippGetInteger(a, 0);
        else if (!std::strcmp(name, kJobMarkerOption))
        {
            const char* value = ippGetString(a, 0, nullptr);
            job.marker = value ? value : "";
        }
    }
    flush();
    return jobs;
}

const char* const kJobAttributes[] = {"job-id",
                                      "job-name",
                                      "job-originating-user-name",
                                      "job-state",
                                      "job-state-reasons",
                                      "job-printer-state-message",
                                      "number-of-documents",
                                      kJobMarkerOption};
} // namespace

int CreateMarkedJob(const std::string& queue, const std::string& title, const OptionList& options,
                    const std::string& marker, CupsError& error)
{
    // The request by hand: the library's own call answers an unknown queue
    // and an unreachable scheduler alike, and the two must be told apart.
    int count = 0;
    cups_option_t* list = nullptr;
    for (const auto& [name, value] : options)
        count = cupsAddOption(name.c_str(), value.c_str(), count, &list);
    if (!marker.empty())
        count = cupsAddOption(kJobMarkerOption, marker.c_str(), count, &list);
    ipp_t* request = ippNewRequest(IPP_OP_CREATE_JOB);
    ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_URI, "printer-uri", nullptr,
                 PrinterUri(queue).c_str());
    ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_NAME, "requesting-user-name", nullptr,
                 cupsUser());
    ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_NAME, "job-name", nullptr, title.c_str());
    cupsEncodeOptions2(request, count, list, IPP_TAG_OPERATION);
    cupsEncodeOptions2(request, count, list, IPP_TAG_JOB);
    cupsEncodeOptions2(request, count, list, IPP_TAG_SUBSCRIPTION);
    cupsFreeOptions(count, list);
    Response response = Request(request);
    ipp_attribute_t* id =
        Succeeded(response) ? ippFindAttribute(response.get(), "job-id", IPP_TAG_INTEGER) : nullptr;
    if (!id)
    {
        Failed(("cannot create a job on " + queue).c_str(), error);
        return 0;
    }
    return ippGetInteger(id, 0);
}

bool SendJobDocument(const std::string& queue, int job, const std::string& title,
                     const std::string& path, CupsError& error)
{
    std::unique_ptr<FILE, FileCloser> file(std::fopen(path.c_str(), "rb"));
    if (!file)
    {
        error.trouble = CupsTrouble::Refused;
        error.reason = "cannot read " + path + ": " + std::strerror(errno);
        return false;
    }
    if (cupsStartDocument(CUPS_HTTP_DEFAULT, queue.c_str(), job, title.c_str(),
                          CUPS_FORMAT_POSTSCRIPT, 1) != HTTP_STATUS_CONTINUE)
        return Failed("the scheduler refused the document", error);
    char buffer[64 * 1024];
    size_t got = 0;
    while ((got = std::fread(buffer, 1, sizeof buffer, file.get())) > 0)
        if (cupsWriteRequestData(CUPS_HTTP_DEFAULT, buffer, got) != HTTP_STATUS_CONTINUE)
        {
            cupsFinishDocument(CUPS_HTTP_DEFAULT, queue.c_str());
            return Failed("sending the document failed", error);
        }
    const bool readFailed = std::ferror(file.get()) != 0;
    if (cupsFinishDocument(CUPS_HTTP_DEFAULT, queue.c_str()) != IPP_STATUS_OK)
        return Failed("the scheduler did not accept the document", error);
    if (readFailed)
    {
        error.trouble = CupsTrouble::Refused;
        error.reason = "reading " + path + " failed";
        return false;
    }
    return true;
}

bool CancelJob(const std::string& queue, int job, CupsError& error)
{
    if (cupsCancelJob2(CUPS_HTTP_DEFAULT, queue.c_str(), job, 1) == IPP_STATUS_OK ||
        cupsLastError() == IPP_STATUS_ERROR_NOT_POSSIBLE ||
        cupsLastError() == IPP_STATUS_ERROR_NOT_FOUND)
        return true;
    return Failed("cannot cancel the job", error);
}

bool GetJobState(int job, JobState& state, bool& found, CupsError& error)
{
    ipp_t* request = ippNewRequest(IPP_OP_GET_JOB_ATTRIBUTES);
    ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_URI, "printer-uri", nullptr,
                 "ipp://localhost/");
    ippAddInteger(request, IPP_TAG_OPERATION, IPP_TAG_INTEGER, "job-id", job);
    ippAddStrings(request, IPP_TAG_OPERATION, IPP_TAG_KEYWORD, "requested-attributes",
                  static_cast<int>(sizeof kJobAttributes / sizeof *kJobAttributes), nullptr,
                  kJobAttributes);
    Response response = Request(request);
    if (cupsLastError() == IPP_STATUS_ERROR_NOT_FOUND)
    {
        found = false;
        return true;
    }
    if (!Succeeded(response))
        return Failed("cannot ask for the job's state", error);
    const std::vector<JobState> jobs = JobsOf(response.get());
    found = !jobs.empty();
    if (found)
        state = jobs.front();
    return true;
}

bool ListMarkedJobs(const std::string& queue, std::map<std::string, std::vector<JobState>>& jobs,
                    CupsError& error)
{
    ipp_t* request = ippNewRequest(IPP_OP_GET_JOBS);
    ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_URI, "printer-uri", nullptr,
                 PrinterUri(queue).c_str());
    ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_KEYWORD, "which-jobs", nullptr, "all");
    ippAddStrings(request, IPP_TAG_OPERATION, IPP_TAG_KEYWORD, "requested-attributes",
                  static_cast<int>(sizeof kJobAttributes / sizeof *kJobAttributes), nullptr,
                  kJobAttributes);
    Response response = Request(request);
    if (!Succeeded(response))
        return Failed(("cannot list the jobs of " + queue).c_str(), error);
    jobs.clear();
    for (const JobState& job : JobsOf(response.get()))
        if (!job.marker.empty())
            jobs[job.marker].push_back(job);
    return true;
}

bool OpenJobIds(const std::string& queue, std::set<int>& ids, CupsError& error)
{
    ipp_t* request = ippNewRequest(IPP_OP_GET_JOBS);
    ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_URI, "printer-uri", nullptr,
                 PrinterUri(queue).c_str());
    ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_KEYWORD, "which-jobs", nullptr,
                 "not-completed");
    ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_KEYWORD, "requested-attributes", nullptr,
                 "job-id");
    Response response = Request(request);
    if (!Succeeded(response))
        return Failed(("cannot list the jobs of " + queue).c_str(), error);
    ids.clear();
    for (ipp_attribute_t* a = ippFindAttribute(response.get(), "job-id", IPP_TAG_INTEGER); a;
         a = ippFindNextAttribute(response.get(), "job-id", IPP_TAG_INTEGER))
        ids.insert(ippGetInteger(a, 0));
    return true;
}

bool GetQueueState(const std::string& queue, QueueState& state, CupsError& error)
{
    static const char* const attributes[] = {"printer-state", "printer-state-reasons",
                                             "printer-state-message", "printer-is-accepting-jobs"};
    ipp_t* request = ippNewRequest(IPP_OP_GET_PRINTER_ATTRIBUTES);
    ippAddString(request, IPP_TAG_OPERATION, IPP_TAG_URI, "printer-uri", nullptr,
                 PrinterUri(queue).c_str());
    ippAddStrings(request, IPP_TAG_OPERATION, IPP_TAG_KEYWORD, "requested-attributes",
                  static_cast<int>(sizeof attributes / sizeof *attributes), nullptr, attributes);
    Response response = Request(request);
    if (!Succeeded(response))
        return Failed(("cannot ask for the state of " + queue).c_str(), error);
    state = QueueState();
    if (ipp_attribute_t* a = ippFindAttribute(response.get(), "printer-state", IPP_TAG_ENUM))
        state.state = ippEnumString("printer-state", ippGetInteger(a, 0));
    if (ipp_attribute_t* a =
            ippFindAttribute(response.get(), "printer-state-reasons", IPP_TAG_KEYWORD))
        for (int i = 0; i < ippGetCount(a); ++i)
            if (std::strcmp(ippGetString(a, i, nullptr), "none") != 0)
                state.reasons.push_back(ippGetString(a, i, nullptr));
    if (ipp_attribute_t* a =
            ippFindAttribute(response.get(), "printer-state-message", IPP_TAG_TEXT))
        state.message = ippGetString(a, 0, nullptr) ? ippGetString(a, 0, nullptr) : "";
    if (ipp_attribute_t* a =
            ippFindAttribute(response.get(), "printer-is-accepting-jobs", IPP_TAG_BOOLEAN))
        state.accepting = ippGetBoolean(a, 0) != 0;
    return true;
}
} // namespace printing
