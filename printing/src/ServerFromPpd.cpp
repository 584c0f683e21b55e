#include "ServerFromPpd.h"

#include "PpdCapabilities.h"
#include "ServerDescriptionWriter.h"

bool ServerDescriptionFromPpd(const std::string& ppdPath, wxString& xml, std::string& error)
{
    printing::PpdCapabilities capabilities;
    if (!printing::ReadPpdCapabilities(ppdPath, capabilities, error))
        return false;
    xml = printing::ServerDescriptionXml(capabilities);
    return true;
}
