#include <gtest/gtest.h>

#include "ServerFixture.h"
#include "db/PluginInitialize.h"

namespace
{
using StrictQuery = bool (*)(const wxString&);

struct StrictFlag
{
    const char* element;
    StrictQuery query;
};

const StrictFlag kStrictFlags[] = {
    {"GA2_HOTFOLDERS", &PluginInitialize::IsServerGA2Enabled},
    {"GA_FEATURE_SET", &PluginInitialize::IsServerGA1Enabled},
    {"HF_XRX_FILTER", &PluginInitialize::IsServerXRXEnabled},
    {"ppmlsupport", &PluginInitialize::IsServerVDPEnabled},
    {"HF_ONE_BIT_TIFF_FILTER", &PluginInitialize::IsServerOneBitTiffEnabled},
};

struct FlagText
{
    const char* text;
    bool strict;
    bool loose;
};

// The two tests differ on purpose: only the loose one ignores case and
// knows "2" and "on".
const FlagText kFlagTexts[] = {
    {"yes", true, true},  {"1", true, true},   {"true", true, true},   {"True", false, true},
    {"YES", false, true}, {"2", false, true},  {"on", false, true},    {"ON", false, true},
    {"no", false, false}, {"0", false, false}, {" yes", false, false}, {"enabled", false, false},
};
} // namespace

TEST(StrictFlags, EachQueryReadsItsOwnElement)
{
    for (const StrictFlag& flag : kStrictFlags)
    {
        EXPECT_TRUE(flag.query(WrapElement(flag.element, "yes"))) << flag.element;
        for (const StrictFlag& other : kStrictFlags)
        {
            if (&other == &flag)
                continue;
            EXPECT_FALSE(other.query(WrapElement(flag.element, "yes")))
                << other.element << " answered for " << flag.element;
        }
    }
}

TEST(StrictAndLooseFlags, AcceptDifferentTexts)
{
    for (const FlagText& variant : kFlagTexts)
    {
        const wxString xml = WrapElement("GA2_HOTFOLDERS", variant.text);
        EXPECT_EQ(variant.strict, PluginInitialize::IsServerGA2Enabled(xml)) << variant.text;
        EXPECT_EQ(variant.loose, PluginInitialize::IsFeatureEnabled(xml, "GA2_HOTFOLDERS"))
            << variant.text;
    }
}

TEST(StrictAndLooseFlags, FullDescription)
{
    const wxString xml = ServerFixture("server-full.xml");
    // "True": strict no, loose yes.
    EXPECT_FALSE(PluginInitialize::IsServerGA2Enabled(xml));
    EXPECT_TRUE(PluginInitialize::IsFeatureEnabled(xml, "GA2_HOTFOLDERS"));
    EXPECT_TRUE(PluginInitialize::IsServerGA1Enabled(xml));
    EXPECT_TRUE(PluginInitialize::IsServerXRXEnabled(xml));
    EXPECT_FALSE(PluginInitialize::IsServerVDPEnabled(xml));
    EXPECT_TRUE(PluginInitialize::IsFeatureEnabled(xml, "ppmlsupport"));
    EXPECT_FALSE(PluginInitialize::IsServerOneBitTiffEnabled(xml));
    EXPECT_TRUE(PluginInitialize::IsFeatureEnabled(xml, "HF_EPS_FILTER"));
    EXPECT_FALSE(PluginInitialize::IsFeatureEnabled(xml, "SubstrateFamilySupported"));
    EXPECT_FALSE(PluginInitialize::IsFeatureEnabled(xml, "NoSuchFeature"));
    // Element names are case-sensitive.
    EXPECT_FALSE(PluginInitialize::IsFeatureEnabled(xml, "hf_eps_filter"));
}

TEST(StrictAndLooseFlags, EmptyElementsAreOff)
{
    const wxString xml = ServerFixture("server-edge.xml");
    EXPECT_FALSE(PluginInitialize::IsServerGA2Enabled(xml));
    EXPECT_FALSE(PluginInitialize::IsFeatureEnabled(xml, "HF_EPS_FILTER"));
    EXPECT_FALSE(PluginInitialize::IsServerXRXEnabled(xml));
}

TEST(XeroxServer, MakerNameIgnoresCase)
{
    EXPECT_TRUE(PluginInitialize::IsXeroxServer(ServerFixture("server-full.xml")));
    EXPECT_TRUE(PluginInitialize::IsXeroxServer(WrapElement("OEMName", "XEROX")));
    EXPECT_FALSE(PluginInitialize::IsXeroxServer(ServerFixture("server-edge.xml")));
    EXPECT_FALSE(PluginInitialize::IsXeroxServer(WrapElement("OEMName", "Xerox Corp")));
    EXPECT_FALSE(PluginInitialize::IsXeroxServer(ServerFixture("server-nested.xml")));
}

TEST(ServerVersion, ComparesLeadingNumber)
{
    const wxString full = ServerFixture("server-full.xml");
    EXPECT_TRUE(PluginInitialize::IsRequiredServerVersion(full, 34));
    EXPECT_TRUE(PluginInitialize::IsRequiredServerVersion(full, 33));
    EXPECT_FALSE(PluginInitialize::IsRequiredServerVersion(full, 35));

    // "12abc" counts as 12.
    const wxString digitsThenLetters = ServerFixture("server-edge.xml");
    EXPECT_TRUE(PluginInitialize::IsRequiredServerVersion(digitsThenLetters, 12));
    EXPECT_FALSE(PluginInitialize::IsRequiredServerVersion(digitsThenLetters, 13));
}

TEST(ServerVersion, TextWithoutNumberCountsAsZero)
{
    const wxString xml = WrapElement("ServerVersion", "beta");
    EXPECT_TRUE(PluginInitialize::IsRequiredServerVersion(xml, 0));
    EXPECT_FALSE(PluginInitialize::IsRequiredServerVersion(xml, 1));
    EXPECT_TRUE(PluginInitialize::IsRequiredServerVersion(WrapElement("ServerVersion", " -3"), -3));
    EXPECT_FALSE(PluginInitialize::IsRequiredServerVersion(WrapElement("ServerVersion", ""), 0));
    EXPECT_FALSE(PluginInitialize::IsRequiredServerVersion(ServerFixture("server-nested.xml"), 0));
}
