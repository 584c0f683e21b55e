// The bytes of the generated job: header and trailer against golden files,
// CR LF line ends, "." decimal points under any locale, failure results.
#include <clocale>
#include <cstdlib>
#include <regex>
#include <string>

#include <gtest/gtest.h>

#include "EngineTestSupport.h"

using namespace hf_test;

namespace
{
const std::string kGoldenDir = std::string(HF_TEST_DATA_DIR) + "/engine/golden/";

// The creation date changes with every run; its shape is checked, then it
// is replaced by a fixed mark.
std::string MaskCreationDate(const std::string& output)
{
    static const std::regex date("%%CreationDate: (\\d\\d)/(\\d\\d)/(\\d\\d) "
                                 "(\\d\\d):(\\d\\d) (AM|PM)\r\n");
    std::smatch match;
    EXPECT_TRUE(std::regex_search(output, match, date)) << "no well-formed creation date";
    return std::regex_replace(output, date, "%%CreationDate: <date>\r\n",
                              std::regex_constants::format_first_only);
}

// Everything but the embedded EPS bytes must end its lines with CR LF.
void ExpectCrLfOutsideDocument(const std::string& output, const std::string& eps)
{
    const size_t begin = output.find("%%BeginDocument:");
    ASSERT_NE(begin, std::string::npos);
    const size_t body = output.find("\r\n", begin) + 2;
    ASSERT_EQ(output.compare(body, eps.size(), eps), 0) << "EPS bytes not copied unchanged";
    const std::string wrapper = output.substr(0, body) + output.substr(body + eps.size());
    for (size_t i = 0; i < wrapper.size(); ++i)
    {
        if (wrapper[i] == '\n')
        {
            EXPECT_TRUE(i > 0 && wrapper[i - 1] == '\r') << "bare LF at " << i;
        }
        if (wrapper[i] == '\r')
        {
            EXPECT_TRUE(i + 1 < wrapper.size() && wrapper[i + 1] == '\n') << "bare CR at " << i;
        }
    }
}

class ConvertOutput_ : public ::testing::Test
{
protected:
    // Converts a filled-box EPS named name with the given box.
    std::string Convert(const std::string& name, const double box[4], const EPStoPSparams_t& params,
                        int* result = nullptr)
    {
        const std::string eps = FilledBoxEps(box[0], box[1], box[2], box[3]);
        const std::string input = scratch.File(name);
        WriteBytes(input, eps);
        const Fingerprint before = TakeFingerprint(input);
        const std::string output = scratch.File("out.ps");
        unlink(output.c_str());
        const int converted = DetectAndConvert(input, params, output);
        if (result)
            *result = converted;
        else
            EXPECT_EQ(converted, 1);
        EXPECT_TRUE(TakeFingerprint(input) == before) << "input changed";
        const std::string bytes = testkit::ReadFile(output);
        ExpectCrLfOutsideDocument(bytes, eps);
        return bytes;
    }

    void ExpectGolden(const std::string& goldenName, const std::string& output)
    {
        const std::string masked = MaskCreationDate(output);
        const std::string path = kGoldenDir + goldenName;
        if (std::getenv("HF_UPDATE_GOLDEN"))
            WriteBytes(path, masked);
        EXPECT_EQ(masked, testkit::ReadFile(path)) << "differs from " << path;
    }

    ScratchDir scratch;
};

const double kLetterBox[4] = {0, 0, 612, 792};
} // namespace

TEST_F(ConvertOutput_, PortraitPictureOnItsOwnPageSize)
{
    EPStoPSparams_t p = NoParams();
    p.pageWidth = 612;
    p.pageHeight = 792;
    const std::string out = Convert("letter.eps", kLetterBox, p);
    EXPECT_NE(out.find("\r\n0 0 translate\r\n0 rotate\r\n1 1 scale\r\n"), std::string::npos);
    ExpectGolden("portrait_letter.ps", out);
}

TEST_F(ConvertOutput_, PortraitPictureOnLandscapePageIsRotated)
{
    EPStoPSparams_t p = NoParams();
    p.pageWidth = 792;
    p.pageHeight = 612;
    const std::string out = Convert("letter.eps", kLetterBox, p);
    EXPECT_NE(out.find("%%Orientation: Landscape\r\n"), std::string::npos);
    EXPECT_NE(out.find("{ 1 userdict /RvLandscapeSetup get exec }"), std::string::npos);
    EXPECT_NE(out.find("\r\n792 0 translate\r\n90 rotate\r\n1 1 scale\r\n"), std::string::npos);
    ExpectGolden("landscape_page.ps", out);
}

TEST_F(ConvertOutput_, WithoutPageThePageIsThePicture)
{
    const double box[4] = {10, 20, 110, 220};
    EPStoPSparams_t p = NoParams();
    p.imagePosition = IMG_POS_CENTER; // ignored without a page
    p.fitToPage = true;
    p.imageableLLX = 50;
    p.imageableURY = 70;
    const std::string out = Convert("nopage.eps", box, p);
    EXPECT_NE(out.find("%%BoundingBox: 0 0 100 200\r\n%%HiResBoundingBox: 0 0 100 200\r\n"),
              std::string::npos);
    ExpectGolden("no_page.ps", out);
}

TEST_F(ConvertOutput_, ImageableAreaCornersInEitherOrderAndFractional)
{
    EPStoPSparams_t p = NoParams();
    p.pageWidth = 612;
    p.pageHeight = 792;
    p.imagePosition = IMG_POS_CENTER;
    p.customSize = p.autoScale = p.fitToPage = true;
    p.imageableLLX = p.imageableLLY = 12.5;
    p.imageableURX = 599.5;
    p.imageableURY = 779.5;
    const double box[4] = {0, 0, 300, 200};
    const std::string ordered = Convert("area.eps", box, p);
    EXPECT_NE(ordered.find("%%BoundingBox: 12 12 600 780\r\n"
                           "%%HiResBoundingBox: 12.5 12.5 599.5 779.5\r\n"),
              std::string::npos);
    ExpectGolden("imageable_fractional.ps", ordered);

    std::swap(p.imageableLLX, p.imageableURX);
    std::swap(p.imageableLLY, p.imageableURY);
    EXPECT_EQ(MaskCreationDate(Convert("area.eps", box, p)), MaskCreationDate(ordered));
}

TEST_F(ConvertOutput_, NegativeAndZeroOriginsNeverPrintMinusZero)
{
    EPStoPSparams_t p = NoParams();
    const double box[4] = {-0.0, 25, 100, -0.0};
    const std::string out = Convert("origin.eps", box, p);
    const std::string wrapper = out.substr(0, out.find("%%BeginDocument"));
    EXPECT_EQ(wrapper.find("-0 "), std::string::npos);
    EXPECT_EQ(wrapper.find("-0\r"), std::string::npos);
    EXPECT_NE(out.find("\r\n0 -25 translate\r\n%%BeginDocument"), std::string::npos);
    ExpectGolden("origin_shift.ps", out);

    const double negative[4] = {-30, -40.5, 70, 60};
    const std::string neg = Convert("neg.eps", negative, p);
    EXPECT_NE(neg.find("\r\n30 40.5 translate\r\n%%BeginDocument"), std::string::npos);
}

TEST_F(ConvertOutput_, PositionBeyondTheFourCornersAndCentreGivesNoOffset)
{
    EPStoPSparams_t p = NoParams();
    p.pageWidth = 612;
    p.pageHeight = 792;
    p.imageableLLX = p.imageableLLY = 36;
    p.imageableURX = 576;
    p.imageableURY = 756;
    p.imagePosition = 7;
    const double box[4] = {0, 0, 100, 200};
    const std::string out = Convert("pos7.eps", box, p);
    EXPECT_NE(out.find("\r\n0 0 translate\r\n0 rotate\r\n"), std::string::npos);
    p.imagePosition = IMG_POS_BOTTOM_LEFT;
    EXPECT_NE(Convert("pos0.eps", box, p).find("\r\n36 36 translate\r\n0 rotate\r\n"),
              std::string::npos);
}

TEST_F(ConvertOutput_, SetPageDeviceTextIsCopiedOrDefaulted)
{
    EPStoPSparams_t p = NoParams();
    const std::string absent = Convert("spd.eps", kLetterBox, p);
    EXPECT_NE(absent.find("if\r\n% No setpagedevice string specified\r\n\r\n%%EndSetup\r\n"),
              std::string::npos);

    char text[] = "<< /PageSize [595.5 842] >> setpagedevice";
    p.setPageDeviceString = text;
    const std::string given = Convert("spd.eps", kLetterBox, p);
    EXPECT_NE(given.find("if\r\n<< /PageSize [595.5 842] >> setpagedevice\r\n%%EndSetup\r\n"),
              std::string::npos);
}

TEST_F(ConvertOutput_, CustomSizeWithConstrainedProportions)
{
    EPStoPSparams_t p = NoParams();
    p.pageWidth = 612;
    p.pageHeight = 792;
    p.customSize = p.autoScale = true;
    p.constrainProportions = p.widthGiven = true;
    p.imageWidth = 150;
    p.imageHeight = 999; // derived from the width instead
    p.imagePosition = IMG_POS_TOP_RIGHT;
    const double box[4] = {0, 0, 100, 200};
    const std::string out = Convert("custom.eps", box, p);
    EXPECT_NE(out.find("\r\n462 492 translate\r\n0 rotate\r\n1.5 1.5 scale\r\n"),
              std::string::npos);
    ExpectGolden("custom_constrained.ps", out);
}

TEST_F(ConvertOutput_, CommaLocaleStillWritesFullStops)
{
    EPStoPSparams_t p = NoParams();
    p.pageWidth = 595.5;
    p.pageHeight = 842.25;
    p.imagePosition = IMG_POS_CENTER;
    p.customSize = p.autoScale = p.fitToPage = true;
    char spd[] = "<< /PageSize [595,5 842,25] >> setpagedevice";
    p.setPageDeviceString = spd;
    const double box[4] = {0.5, 0.25, 300.75, 200.5};

    const std::string inC = MaskCreationDate(Convert("x.eps", box, p));
    const std::string saved = setlocale(LC_ALL, nullptr);
    if (!setlocale(LC_ALL, "de_DE.UTF-8"))
        GTEST_SKIP() << "de_DE.UTF-8 locale not installed (scripts/setup.sh makes it)";
    char probe[16];
    std::snprintf(probe, sizeof probe, "%g", 1.5);
    const std::string inGerman = MaskCreationDate(Convert("x.eps", box, p));
    const std::string commaName = Convert("pic,1.eps", box, p);
    setlocale(LC_ALL, saved.c_str());
    ASSERT_STREQ(probe, "1,5") << "the locale did not switch the decimal point";

    // Only the texts change: the locale's decimal point becomes "." in them.
    std::string expected = inC;
    expected.replace(expected.find("[595,5 842,25]"), 14, "[595.5 842.25]");
    EXPECT_EQ(inGerman, expected);
    EXPECT_NE(inGerman.find("%%HiResBoundingBox: 0 0 595.5 842.25\r\n"), std::string::npos);
    EXPECT_NE(commaName.find("%%Title: /pic.1.eps\r\n"), std::string::npos);
    EXPECT_NE(commaName.find("%%BeginDocument: /pic.1.eps\r\n"), std::string::npos);
}

TEST_F(ConvertOutput_, ShortCopyStillEndsWithTheTrailer)
{
    // A DOS header whose section runs past the end of the file.
    const std::string body = FilledBoxEps(0, 0, 10, 10);
    const std::string input = scratch.File("short.eps");
    WriteBytes(input, DosEpsHeader(30, 5000) + body);
    StderrCapture capture;
    const int result = DetectAndConvert(input, NoParams(), scratch.File("out.ps"));
    const std::string messages = capture.Text();
    EXPECT_EQ(result, 1);
    EXPECT_EQ(messages, "Premature EOF with leftover BytesToRead = " +
                            std::to_string(5000 - body.size()) + "\n");
    const std::string out = testkit::ReadFile(scratch.File("out.ps"));
    const std::string trailer = "%%EndDocument\r\ncount @ST_count sub\r\n{ pop }\r\nrepeat\r\n"
                                "countdictstack @ST_countdictstack sub\r\n{ end }\r\nrepeat\r\n"
                                "@ST_save\r\nend\r\nrestore\r\nshowpage\r\n%%Trailer\r\n%%EOF\r\n";
    ASSERT_GE(out.size(), trailer.size());
    EXPECT_EQ(out.substr(out.size() - trailer.size()), trailer);
    EXPECT_NE(out.find("%%BeginDocument: /short.eps\r\n%%EndDocument"), std::string::npos);
}

TEST_F(ConvertOutput_, FailuresReleaseTheContextExceptForAnEmptySlot)
{
    const EPStoPSparams_t p = NoParams();
    EXPECT_EQ(ConvertEPStoPS(nullptr, &p, scratch.File("a.ps").c_str()), 0);
    void* empty = nullptr;
    EXPECT_EQ(ConvertEPStoPS(&empty, &p, scratch.File("a.ps").c_str()), 0);

    const std::string input = scratch.File("in.eps");
    WriteBytes(input, FilledBoxEps(0, 0, 10, 10));
    void* context = nullptr;
    ASSERT_EQ(IsThisEPS(input.c_str(), &context), 1u);
    EXPECT_EQ(ConvertEPStoPS(&context, &p, scratch.File("no/such/folder/a.ps").c_str()), 0);
    EXPECT_EQ(context, nullptr);

    // A full disk: the job is not complete and must not count as written.
    ASSERT_EQ(IsThisEPS(input.c_str(), &context), 1u);
    EXPECT_EQ(ConvertEPStoPS(&context, &p, "/dev/full"), 0);
    EXPECT_EQ(context, nullptr);
}
