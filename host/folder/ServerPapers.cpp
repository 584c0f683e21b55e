#include "folder/ServerPapers.h"

#include "db/PluginInitialize.h"

void ServerPapers::Load(const wxString& serverDescription)
{
    sheets.clear();
    defaultPaper.clear();
    PluginInitialize::InitializeSheetInfo(serverDescription, sheets);
    stPageAttribute page;
    if (PluginInitialize::InitializeDefaultSheetInfo(serverDescription, page))
        defaultPaper = page.PaperName;
}
