#pragma once
#include <fstream>
#include <sstream>
#include <string>

#include <wx/string.h>

// The text of a server description under tests/data/server, as the host
// hands it over.
inline wxString ServerFixture(const std::string& name)
{
    std::ifstream in(std::string(HF_TEST_DATA_DIR) + "/server/" + name, std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    return wxString::FromUTF8(text.str());
}

// A one-element description for the flag and value variants.
inline wxString WrapElement(const wxString& name, const wxString& text)
{
    return "<?xml version=\"1.0\" encoding=\"UTF-8\"?><ServerDescription><Info><" + name + ">" +
           text + "</" + name + "></Info></ServerDescription>";
}
