#pragma once
// A German user's client setup: the workstation language file says de_DE and
// the client configuration is version 3.3, the first that follows it. Both go
// to a private home, set up before the toolkit and the client configuration
// are first used, and removed with everything in it when the program ends.
#include <cstdlib>

#include "TestKit.h"

inline void UseGermanClientConfiguration()
{
    static const testkit::ScratchDir home("hf-ui-german");
    const std::string resources = home.Sub("Resources");
    testkit::WriteFile(home.Sub("Vomal QDK") + "/current.lang", "de_DE\n");
    testkit::WriteFile(resources + "/HFConfig.cfg",
                       "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<HFConfig><Application>"
                       "<HFConfiguration><Entry key=\"APP_HF_VERSION\" value=\"3.3\"/>"
                       "</HFConfiguration></Application></HFConfig>\n");
    setenv("HOME", home.Path().c_str(), 1);
    setenv("HOTFOLDER_RESOURCES_DIR", resources.c_str(), 1);
}
