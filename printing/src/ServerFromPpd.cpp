#include "ServerFromPpd.h"

#include "PpdCapabilities.h"
#include "ServerDescriptionWriter.h"

namespace printing
{
bool ServerDescriptionFromPpd(const std::string& ppdPath, wxString& xml, std::string& error)
{
    PpdCapabilities capabilities;
    if (!ReadPpdCapabilities(ppdPath, capabilities, error))
        return false;
    xml = ServerDescriptionXml(capabilities);
    return true;
}
} // namespace printing
