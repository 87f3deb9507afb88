// A GUI run of a wizard as the host makes it: the window with the plug-in's
// pages and the summary page, walked with Next to the end; Finish writes the
// files the summary promised, Cancel writes nothing.

#include "gui/Gq_SummaryPage.h"
#include "gui/Gq_Wizard.h"

#include <QPushButton>
#include "run/Tsy_HostSession.h"
#include "support/TestDesign.h"
#include "wiz/Tsy_MessageStreams.h"
#include "wiz/Tsy_WizMain.h"

#include <gtest/gtest.h>

#include <sys/stat.h>

namespace {

bool exists(const std::string& path)
{
    struct stat st {};
    return ::stat(path.c_str(), &st) == 0;
}

struct GuiRun {
    Tsy_RecordingStream stream;
    Tsy_HostSession session{stream};
    Gq_Wizard window;

    explicit GuiRun(const std::string& outDir, const std::string& module = "top")
    {
        Tsy_RunOptions o;
        o.wizard = "dcm";
        o.part = "t5da1-1";
        o.module = module;
        o.outDir = outDir;
        o.batch = false;
        std::string error;
        EXPECT_EQ(session.Prepare(o, error), Tsy_HostSession::kOk) << error;
        session.Wizard()->InstantiatePages();
        session.Wizard()->PrepareGui(&window);
        window.start();
    }

    // Next until the last page; false if a page refused.
    bool walkToEnd()
    {
        for (int guard = 0; guard < 20 && window.currentIndex() + 1 < window.pageCount(); ++guard)
            if (!window.goNext())
                return false;
        return window.currentPage() == session.Wizard()->GetSummaryPage();
    }
};

} // namespace

TEST(GuiRun, FinishWritesWhatTheSummaryPromised)
{
    TempDir dir;
    GuiRun run(dir.File("out"));
    ASSERT_GT(run.window.pageCount(), 0);
    ASSERT_TRUE(run.walkToEnd()) << (run.stream.Errors().empty() ? "" : run.stream.Errors()[0].str());
    auto* summary = dynamic_cast<Gq_SummaryPage*>(run.window.currentPage());
    ASSERT_NE(summary, nullptr);
    std::string html = summary->html().toStdString();
    EXPECT_NE(html.find("Module top"), std::string::npos);
    EXPECT_NE(html.find("t5da1-1"), std::string::npos);
    for (const auto& f : run.session.PlannedFiles())
        EXPECT_NE(html.find(f), std::string::npos) << f;
    EXPECT_FALSE(exists(dir.File("out/top.tsw"))) << "nothing is written before Finish";

    EXPECT_TRUE(run.window.finish());
    EXPECT_EQ(run.window.result(), QDialog::Accepted);
    EXPECT_TRUE(run.stream.Errors().empty());
    for (const auto& f : run.session.PlannedFiles())
        EXPECT_TRUE(exists(f)) << f;
    EXPECT_EQ(run.session.WrittenFiles(), run.session.PlannedFiles());
}

TEST(GuiRun, CancelWritesNothing)
{
    TempDir dir;
    GuiRun run(dir.File("out"));
    run.walkToEnd();
    run.window.button(Gq_Wizard::Cancel)->click();
    EXPECT_EQ(run.window.result(), QDialog::Rejected);
    EXPECT_FALSE(exists(dir.File("out")));
}

TEST(GuiRun, AFailedWriteKeepsTheWindowOpenWithTheReason)
{
    TempDir dir;
    // The output folder cannot be made: a file stands where it should be.
    std::string blocked = dir.File("blocked");
    ASSERT_TRUE(RunCommand("touch '" + blocked + "'").status == 0);
    GuiRun run(blocked + "/sub");
    ASSERT_TRUE(run.walkToEnd());
    EXPECT_FALSE(run.window.finish());
    ASSERT_FALSE(run.stream.Errors().empty());
    EXPECT_NE(run.stream.Errors().back().str().find("blocked/sub"), std::string::npos) << run.stream.Errors().back();
    EXPECT_TRUE(run.session.WrittenFiles().empty());
}
