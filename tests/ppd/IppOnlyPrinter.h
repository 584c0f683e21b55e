#pragma once
// A network printer known only by its IPP answer: every request gets the
// printer attributes of a table, and it has no PPD to hand out. A CUPS 2.4
// scheduler never presents a queue like this (it makes a PPD for each), and
// the IPP printer simulator needs a DNS-SD daemon, so the test answers for
// the printer itself, with libcups's own HTTP and IPP code on a loopback port.
#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <atomic>
#include <string>
#include <thread>
#include <vector>

#include <cups/cups.h>

#include "CaseTable.h"

namespace cups_test
{
class IppOnlyPrinter
{
public:
    // table: "attribute | keyword, integer or text | values, separated by ', ' | why".
    explicit IppOnlyPrinter(const std::string& table) : m_attributes(testkit::ReadCaseTable(table))
    {
    }
    ~IppOnlyPrinter()
    {
        m_stop = true;
        if (m_acceptor.joinable())
            m_acceptor.join();
        for (std::thread& connection : m_connections)
            connection.join();
        if (m_listen >= 0)
            close(m_listen);
    }
    IppOnlyPrinter(const IppOnlyPrinter&) = delete;
    IppOnlyPrinter& operator=(const IppOnlyPrinter&) = delete;

    // False when the table is empty or no loopback port is free.
    bool Start()
    {
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t size = sizeof address;
        m_listen = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
        if (m_attributes.empty() || m_listen < 0 ||
            bind(m_listen, reinterpret_cast<sockaddr*>(&address), size) != 0 ||
            getsockname(m_listen, reinterpret_cast<sockaddr*>(&address), &size) != 0 ||
            listen(m_listen, 8) != 0)
            return false;
        m_port = ntohs(address.sin_port);
        m_acceptor = std::thread([this] { Accept(); });
        return true;
    }

    // For CUPS_SERVER.
    std::string Server() const { return "localhost:" + std::to_string(m_port); }

private:
    void Accept()
    {
        while (!m_stop)
        {
            pollfd waiting{m_listen, POLLIN, 0};
            if (poll(&waiting, 1, 100) != 1)
                continue;
            if (http_t* http = httpAcceptConnection(m_listen, 1))
                m_connections.emplace_back([this, http] { Serve(http); });
        }
    }

    // Requests on one connection until the client closes it.
    void Serve(http_t* http)
    {
        while (!m_stop)
        {
            if (!httpWait(http, 100))
                continue;
            char uri[1024];
            const http_state_t state = httpReadRequest(http, uri, sizeof uri);
            if (state != HTTP_STATE_POST && state != HTTP_STATE_GET)
                break;
            http_status_t status;
            while ((status = httpUpdate(http)) == HTTP_STATUS_CONTINUE)
                ;
            if (status != HTTP_STATUS_OK)
                break;
            const bool expectsContinue = httpGetExpect(http) == HTTP_STATUS_CONTINUE;
            httpClearFields(http);
            if (state == HTTP_STATE_GET) // a PPD: there is none
            {
                httpSetLength(http, 0);
                if (httpWriteResponse(http, HTTP_STATUS_NOT_FOUND))
                    break;
                continue;
            }
            if (expectsContinue)
                httpWriteResponse(http, HTTP_STATUS_CONTINUE);
            ipp_t* request = ippNew();
            ipp_state_t read;
            while ((read = ippRead(http, request)) != IPP_STATE_DATA && read != IPP_STATE_ERROR)
                ;
            ipp_t* response = ippNewResponse(request);
            ippDelete(request);
            AddAttributes(response);
            httpSetField(http, HTTP_FIELD_CONTENT_TYPE, "application/ipp");
            httpSetLength(http, ippLength(response));
            bool written = read == IPP_STATE_DATA && !httpWriteResponse(http, HTTP_STATUS_OK);
            ipp_state_t wrote;
            while (written && (wrote = ippWrite(http, response)) != IPP_STATE_DATA)
                written = wrote != IPP_STATE_ERROR;
            ippDelete(response);
            if (!written)
                break;
        }
        httpClose(http);
    }

    void AddAttributes(ipp_t* response) const
    {
        for (const testkit::CaseFields& row : m_attributes)
        {
            const std::vector<std::string> values = testkit::Split(row.at(2), ", ");
            const char* name = row[0].c_str();
            if (row[1] == "integer")
            {
                std::vector<int> numbers;
                for (const std::string& value : values)
                    numbers.push_back(std::stoi(value));
                ippAddIntegers(response, IPP_TAG_PRINTER, IPP_TAG_INTEGER, name,
                               static_cast<int>(numbers.size()), numbers.data());
                continue;
            }
            std::vector<const char*> texts;
            for (const std::string& value : values)
                texts.push_back(value.c_str());
            ippAddStrings(response, IPP_TAG_PRINTER,
                          row[1] == "text" ? IPP_TAG_TEXT : IPP_TAG_KEYWORD, name,
                          static_cast<int>(texts.size()), nullptr, texts.data());
        }
    }

    const std::vector<testkit::CaseFields> m_attributes;
    int m_listen = -1;
    int m_port = 0;
    std::atomic<bool> m_stop{false};
    std::thread m_acceptor;
    std::vector<std::thread> m_connections; // only the acceptor adds to it
};
} // namespace cups_test
