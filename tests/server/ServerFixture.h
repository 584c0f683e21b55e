#pragma once
#include <string>

#include <wx/string.h>

#include "GhostscriptOracle.h"

// The text of a server description under tests/data/server, as the host
// hands it over.
inline wxString ServerFixture(const std::string& name)
{
    return wxString::FromUTF8(
        testkit::ReadFile(std::string(HF_TEST_DATA_DIR) + "/server/" + name));
}

// A one-element description for the flag and value variants.
inline wxString WrapElement(const wxString& name, const wxString& text)
{
    return "<?xml version=\"1.0\" encoding=\"UTF-8\"?><ServerDescription><Info><" + name + ">" +
           text + "</" + name + "></Info></ServerDescription>";
}
