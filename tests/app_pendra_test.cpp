// The pendra program as a user runs it: listings, exit codes and the one-line
// errors of bad options and bad design files, and what a batch run writes.

#include "support/BatchRun.h"

#include <gtest/gtest.h>

#include <fstream>

namespace {

CommandResult run(const std::string& args)
{
    return RunCommand(PendraProgram() + " " + args);
}

int lines(const std::string& text)
{
    int n = 0;
    for (char c : text)
        n += c == '\n';
    return n;
}

void write(const std::string& path, const std::string& text)
{
    std::ofstream(path) << text;
}

} // namespace

TEST(Pendra, VersionAndHelp)
{
    CommandResult v = run("--version");
    EXPECT_EQ(v.status, 0);
    EXPECT_EQ(v.out, "pendra 1.0.0\n");
    CommandResult h = run("--help");
    EXPECT_EQ(h.status, 0);
    for (const char* cmd : {"generate", "gui", "parts", "wizards"})
        EXPECT_NE(h.out.find(cmd), std::string::npos) << cmd;
}

TEST(Pendra, ListsTheEightWizardTypes)
{
    CommandResult r = run("wizards");
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(lines(r.out), 8);
    for (const char* key : {"dcm ", "dcm_bddeskew", "dcm_clkfwd", "dcm_clkswitch", "dcm_cascading", "dcm_pll ",
                            "dcm_dcm2pll", "dcm_pll2dcm"})
        EXPECT_NE(r.out.find(key), std::string::npos) << key;
}

TEST(Pendra, ListsPartsWithFamilyDeviceAndGrade)
{
    CommandResult all = run("parts");
    ASSERT_EQ(all.status, 0) << all.err;
    EXPECT_GT(lines(all.out), 30);
    CommandResult t5 = run("parts taldor5");
    ASSERT_EQ(t5.status, 0);
    EXPECT_GT(lines(t5.out), 10);
    EXPECT_EQ(t5.out.find("membra"), std::string::npos);
    EXPECT_NE(t5.out.find("t5da1-1 "), std::string::npos);
    CommandResult none = run("parts zzzz");
    EXPECT_EQ(none.status, 0);
    EXPECT_EQ(none.out, "");
}

TEST(Pendra, RefusesBadOptionsWithOneLineAndExitTwo)
{
    TempDir dir;
    write(dir.File("broken.tsw"), "{ \"format\": 1, \"wizard\": \"dcm\",\n  \"part\": [ }");
    write(dir.File("typo.tsw"), R"({"format": 1, "wizard": "dcm", "part": "t5da1-1", "blocks": [{"name": "X", "type": "BUFGX"}]})");
    struct Case {
        std::string args;
        std::string expected; // in the one line on standard error
    } cases[] = {
        {"generate --wizard dcm --part nosuch-1", "--part nosuch-1: unknown part"},
        {"generate --wizard frob --part t5da1-1", "--wizard frob: unknown wizard type"},
        {"generate --wizard dcm_pll --part t2p7-5", "cannot build it"},
        {"generate --wizard dcm --part t5da1-1 --module 2fast", "--module 2fast"},
        {"generate --wizard dcm --part t5da1-1 --module entity", "VHDL keyword"},
        {"generate --wizard dcm --part t5da1-1 --module a-b", "--module a-b"},
        {"generate --wizard dcm --part t5da1-1 --module bufg", "the name of a library primitive"},
        {"generate --wizard dcm", "both --wizard and --part"},
        {"generate " + dir.File("missing.tsw"), "missing.tsw"},
        {"generate " + dir.File("broken.tsw"), "broken.tsw: line 2, column"},
        {"generate " + dir.File("typo.tsw"), "typo.tsw: blocks[0].type: unknown primitive 'BUFGX'"},
        {"generate --wizard dcm --part t5da1-1 --set CLKIN_PERIOD", "--set 'CLKIN_PERIOD' is not of the form"},
        {"generate --wizard dcm --part t5da1-1 --pin dcm.CLK90=maybe", "on or off"},
        {"generate --wizard dcm --part t5da1-1 --set gizmo.X=1", "--set gizmo.X=1: unknown target"},
        {"generate --wizard dcm --part t5da1-1 --set dcm2.X=1", "one DCM only"},
        {"generate --wizard dcm --part t5da1-1 --set dcm.NO_SUCH=1", "DCM_ADV has no attribute NO_SUCH"},
        {"generate --wizard dcm --part t5da1-1 --pin dcm.CLK99=on", "DCM_ADV has no pin CLK99"},
        {"generate --wizard dcm --part t5da1-1 --bogus", "--bogus"},
        {"frobnicate", "frobnicate"},
        {"", "subcommand"},
    };
    for (const auto& c : cases) {
        CommandResult r = RunCommand("cd '" + dir.Path() + "' && " + PendraProgram() + " " + c.args);
        EXPECT_EQ(r.status, 2) << c.args << "\n" << r.err;
        EXPECT_EQ(lines(r.err), 1) << c.args << "\n" << r.err;
        EXPECT_NE(r.err.find(c.expected), std::string::npos) << c.args << "\n" << r.err;
        EXPECT_EQ(r.out, "") << c.args;
    }
    CommandResult ls = RunCommand("ls '" + dir.Path() + "'");
    EXPECT_EQ(ls.out, "broken.tsw\ntypo.tsw\n") << "nothing written by a refused run";
}

TEST(Pendra, BatchRunWritesTheDesignAndReadsItBack)
{
    TempDir dir;
    CommandResult r = run("generate --wizard dcm --part t5da1-1 --module top -o " + dir.File("out"));
    ASSERT_EQ(r.status, 0) << r.err;
    std::string tsw = dir.File("out/top.tsw");
    EXPECT_NE(r.out.find(tsw), std::string::npos) << r.out;
    std::string saved = ReadTextFile(tsw);
    EXPECT_NE(saved.find("\"wizard\": \"dcm\""), std::string::npos);
    EXPECT_NE(saved.find("\"part\": \"t5da1-1\""), std::string::npos);
    EXPECT_NE(saved.find("\"version\": \"1.0.0\""), std::string::npos);

    CommandResult again = run("generate " + tsw + " -o " + dir.File("again"));
    ASSERT_EQ(again.status, 0) << again.err;
    EXPECT_NE(again.out.find(dir.File("again/top.tsw")), std::string::npos);

    CommandResult mismatch = run("generate " + tsw + " --wizard dcm_cascading");
    EXPECT_EQ(mismatch.status, 2);
    EXPECT_NE(mismatch.err.find("is a 'dcm' design"), std::string::npos) << mismatch.err;
}
