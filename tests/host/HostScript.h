#pragma once
// Host tests as tables: each line of a file under tests/data/host is one step
// "STEP | EXPECTATION | what it checks", run in order.
//   fresh                 a new scratch folder with its own warehouse
//   hotfolder ARG...      runs the built host; EXPECTATION is the exit status,
//                         then optionally one check of out or err ("out~TEXT")
//   then                  one more check of the last run: "err=TEXT"
//   write PATH            writes EXPECTATION to PATH
//   copy NAME PATH        copies examples/eps/NAME to PATH
//   mkdir PATH | setenv NAME VALUE | unsetenv NAME
//   file PATH             checks PATH's content: "~TEXT", "same OTHER", "absent"
//   await PATH            as file, waiting up to a minute for it to hold
//   list DIR              DIR's entries, ", " between them
//   page PS               Ghostscript: page "W H" (0.5 pt), then the marks'
//                         box "LLX LLY URX URY" (1.5 pt)
//   cupsd                 a private CUPS scheduler from here on (the rest of
//                         the file is skipped where CUPS is not installed)
//   queue NAME PPD FILE   a scheduler queue printing to FILE | cupsd-stop
//   ipp-printer TABLE     from here on the "scheduler" is a network printer
//                         answering IPP with the attributes of TABLE (under
//                         tests/data), without a PPD
// Checks of text: "~T" contains, "!~T" does not, "=T" is exactly, "#N T"
// contains N times. Arguments are split at blanks; "double quotes" keep
// blanks. In every field: $S scratch, $H $S/hot, $C its container, $K its
// kept originals, $F its failed files, $W the warehouse, $EX examples/eps,
// $SERVER the example server, $DATA tests/data, $BAD a module without an
// entry point, $CUPS the scheduler's address, \n a new line, \t a tab.
#include <memory>

#include "GhostscriptOracle.h"
#include "HostTestSupport.h"
#include "IppOnlyPrinter.h"
#include "PrivateCupsd.h"

namespace host_test
{
class HostScript : public HostTest
{
protected:
    void TearDown() override { unsetenv("CUPS_SERVER"); }

    void Run(const std::string& table)
    {
        const auto steps = testkit::ReadCaseTable("host/" + table);
        ASSERT_FALSE(steps.empty()) << table;
        root = scratch;
        for (const testkit::CaseFields& fields : steps)
        {
            std::string line = fields[0];
            for (size_t i = 1; i < fields.size(); ++i)
                line += " | " + fields[i];
            SCOPED_TRACE(table + ": " + line);
            const std::vector<std::string> words = Words(Expand(fields[0]));
            const std::string expected = fields.size() > 2 ? Expand(fields[1]) : "";
            if (!Step(words, expected))
                return;
        }
    }

private:
    // False when the rest of the table cannot run.
    bool Step(const std::vector<std::string>& words, const std::string& expected)
    {
        const std::string& verb = words.at(0);
        const std::string arg = words.size() > 1 ? words[1] : "";
        if (verb == "fresh")
        {
            cups.reset();
            printer.reset();
            scratches.push_back(std::make_unique<testkit::ScratchDir>("hf-host-test"));
            root = scratches.back()->Path();
            setenv("HOTFOLDER_WAREHOUSE_ROOT", (root + "/machine").c_str(), 1);
        }
        else if (verb == "hotfolder")
        {
            std::vector<std::string> args = words;
            args[0] = kHost;
            last = testkit::RunProgram(args);
            EXPECT_EQ(std::to_string(last.exitCode), expected.substr(0, expected.find(' ')))
                << last.out << last.err;
            if (expected.find(' ') != std::string::npos)
                CheckLast(expected.substr(expected.find(' ') + 1));
        }
        else if (verb == "then")
            CheckLast(expected);
        else if (verb == "write")
            EXPECT_TRUE(WriteFile(arg, expected));
        else if (verb == "copy")
            EXPECT_TRUE(WriteFile(words.at(2), ReadFile(kExamples + "/eps/" + arg)));
        else if (verb == "mkdir")
            EXPECT_EQ(mkdir(arg.c_str(), 0755), 0);
        else if (verb == "setenv")
            setenv(arg.c_str(), words.at(2).c_str(), 1);
        else if (verb == "unsetenv")
            unsetenv(arg.c_str());
        else if (verb == "file" || verb == "await")
            EXPECT_TRUE(
                WaitFor([&] { return FileHolds(arg, expected); }, verb == "await" ? 60000 : 0))
                << expected << "\n"
                << ReadFile(arg);
        else if (verb == "list")
        {
            std::string names;
            for (const std::string& name : ListDirectory(arg))
                names += (names.empty() ? "" : ", ") + name;
            EXPECT_EQ(names, expected);
        }
        else if (verb == "page")
        {
            const hf_test::GhostscriptReport gs = hf_test::RunGhostscriptBBox(arg);
            EXPECT_FALSE(gs.postscriptError) << gs.process.err;
            double box[6] = {};
            const int n = std::sscanf(expected.c_str(), "%lf %lf %lf %lf %lf %lf", &box[0], &box[1],
                                      &box[2], &box[3], &box[4], &box[5]);
            const double seen[6] = {gs.pageWidth, gs.pageHeight, gs.marks.llx,
                                    gs.marks.lly, gs.marks.urx,  gs.marks.ury};
            for (int i = 0; i < n; ++i)
                EXPECT_NEAR(seen[i], box[i], i < 2 ? 0.5 : 1.5) << "value " << i;
        }
        else if (verb == "cupsd")
        {
            if (!cups_test::PrivateCupsd::Installed())
            {
                std::printf("skipped from here on: %s\n", cups_test::PrivateCupsd::kMissing);
                return false;
            }
            chmod(root.c_str(), 0755); // the queues' filters run as the print user
            mkdir((root + "/cups").c_str(), 0755);
            cups = std::make_unique<cups_test::PrivateCupsd>(root + "/cups");
            std::string problem;
            EXPECT_TRUE(cups->Start(problem)) << problem;
            setenv("CUPS_SERVER", cups->Server().c_str(), 1);
        }
        else if (verb == "queue")
        {
            std::string problem;
            EXPECT_TRUE(cups->AddFileQueue(arg, words.at(2), words.at(3), problem)) << problem;
        }
        else if (verb == "cupsd-stop")
            cups->Stop();
        else if (verb == "ipp-printer")
        {
            printer = std::make_unique<cups_test::IppOnlyPrinter>(arg);
            EXPECT_TRUE(printer->Start()) << arg;
            setenv("CUPS_SERVER", printer->Server().c_str(), 1);
        }
        else
            ADD_FAILURE() << "unknown step " << verb;
        return !HasFatalFailure();
    }

    void CheckLast(const std::string& check)
    {
        const bool out = check.rfind("out", 0) == 0;
        EXPECT_TRUE(out || check.rfind("err", 0) == 0) << "out or err: " << check;
        EXPECT_TRUE(TextHolds(check.substr(3), out ? last.out : last.err))
            << check << "\nout: " << last.out << "\nerr: " << last.err;
    }

    static bool TextHolds(const std::string& check, const std::string& text)
    {
        if (check.rfind("!~", 0) == 0)
            return text.find(check.substr(2)) == std::string::npos;
        if (check[0] == '~')
            return text.find(check.substr(1)) != std::string::npos;
        if (check[0] == '=')
            return text == check.substr(1);
        const std::string part = check.substr(check.find(' ') + 1);
        size_t count = 0;
        for (size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + 1))
            ++count;
        return check[0] == '#' && std::to_string(count) == check.substr(1, check.find(' ') - 1);
    }

    bool FileHolds(const std::string& path, const std::string& check)
    {
        if (check == "absent" || check == "exists")
            return Exists(path) == (check == "exists");
        if (check.rfind("same ", 0) == 0)
            return Exists(path) && ReadFile(path) == ReadFile(check.substr(5));
        return Exists(path) && TextHolds(check, ReadFile(path));
    }

    std::string Expand(std::string text) const
    {
        const std::string hot = root + "/hot", container = hot + "/" + kContainer;
        const std::pair<const char*, std::string> names[] = {{"$SERVER", kServer},
                                                             {"$DATA", HF_TEST_DATA_DIR},
                                                             {"$BAD", HF_BAD_MODULE},
                                                             {"$CUPS", cups      ? cups->Server()
                                                                       : printer ? printer->Server()
                                                                                 : ""},
                                                             {"$EX", kExamples + "/eps"},
                                                             {"$H", hot},
                                                             {"$C", container},
                                                             {"$K", container + "/[MoveFolder]"},
                                                             {"$F", container + "/[FailedFolder]"},
                                                             {"$W", root + "/machine/HotFolders"},
                                                             {"$S", root},
                                                             {"\\n", "\n"},
                                                             {"\\t", "\t"}};
        for (const auto& [name, value] : names)
            for (size_t at = text.find(name); at != std::string::npos;
                 at = text.find(name, at + value.size()))
                text.replace(at, std::string(name).size(), value);
        return text;
    }

    static std::vector<std::string> Words(const std::string& text)
    {
        std::vector<std::string> words;
        std::string word;
        bool quoted = false, any = false;
        for (const char c : text)
        {
            if (c == '"')
                quoted = !quoted, any = true;
            else if (c == ' ' && !quoted)
            {
                if (any)
                    words.push_back(word);
                word.clear();
                any = false;
            }
            else
                word += c, any = true;
        }
        if (any)
            words.push_back(word);
        return words;
    }

    std::string root;
    std::vector<std::unique_ptr<testkit::ScratchDir>> scratches;
    std::unique_ptr<cups_test::PrivateCupsd> cups;
    std::unique_ptr<cups_test::IppOnlyPrinter> printer;
    testkit::ProcessResult last;
};
} // namespace host_test
