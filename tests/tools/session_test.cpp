// duduzu-shell run as a program: the sample session against its transcript,
// redirection and log files, and the tool's own command line.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <climits>
#include <cstdlib>
#include <string>

#include "support/temp_dir.h"

namespace {

struct ShellRun {
  int status;  // the tool's exit status
  std::string out, err;
};

// Runs the tool in `work` (also its TMPDIR) with a fixed environment and
// clock, standard input from `input`.
ShellRun RunShell(const TempDir& work, const std::string& args, const std::string& input = "") {
  TempDir io;
  WriteFile(io / "in", input);
  std::string command = "cd '" + work.path + "' && env -u DUDUZU_NO_SUCH_NAME HOME=/home/designer TMPDIR='" +
                        work.path + "' '" DUDUZU_SHELL "' -clock 12340 " + args + " <'" + io / "in" + "' >'" +
                        io / "out" + "' 2>'" + io / "err" + "'";
  int status = system(command.c_str());
  return ShellRun{WIFEXITED(status) ? WEXITSTATUS(status) : -1, ReadFile(io / "out"), ReadFile(io / "err")};
}

}  // namespace

TEST(SampleSession, OutputMatchesTranscriptAndNothingIsLeftBehind) {
  TempDir work;
  ShellRun run = RunShell(work, "'" DUDUZU_EXAMPLES "/session.cmd'");
  EXPECT_EQ(run.status, 0);
  EXPECT_EQ(run.err, "");
  char real[PATH_MAX];
  ASSERT_NE(realpath(work.path.c_str(), real), nullptr);
  std::string out = run.out, dir = real;  // the scratch directory as <TMPDIR>
  for (size_t at = 0; (at = out.find(dir, at)) != std::string::npos;) out.replace(at, dir.size(), "<TMPDIR>");
  EXPECT_EQ(out, ReadFile(DUDUZU_EXAMPLES "/session.expected"));
  EXPECT_TRUE(std::filesystem::is_empty(work.path));  // scratch files are gone again
}

TEST(Redirection, CapturesUntilRestoredCopiesAndIsRestoredAtTheEnd) {
  TempDir work;
  ShellRun run = RunShell(work, "",
                          "mint 255 -to 16\nredirect out.txt\n  # comments and blank lines are skipped\n\n"
                          "mint 255 -to 2\nmint\nrestore\ncopy -ifn out.txt -ofn copy.txt\n"
                          "redirect a.txt\nredirect b.txt\ngetdef x\n");
  EXPECT_EQ(run.status, 0);
  EXPECT_EQ(run.out,
            "> mint 255 -to 16\nFF\n> redirect out.txt\n"
            "> copy -ifn out.txt -ofn copy.txt\ncopied out.txt to copy.txt\n> redirect a.txt\n");
  const std::string captured =
      "> mint 255 -to 2\n11111111\n> mint\n"
      "ERROR:DuduzuShell - line 6: mint: parameters '' rejected; "
      "mint takes \"S\" \"-from I -to I -width I -prefix\"\n"
      "> restore\n";
  EXPECT_EQ(ReadFile(work / "out.txt"), captured);
  EXPECT_EQ(ReadFile(work / "copy.txt"), captured);
  EXPECT_EQ(ReadFile(work / "a.txt"), "> redirect b.txt\n");
  EXPECT_EQ(ReadFile(work / "b.txt"), "> getdef x\nx has no default\n");
}

TEST(LogFile, IntegrationStyleKeepsStatusOffTheConsoleButInTheLog) {
  TempDir work;
  ShellRun run = RunShell(work, "-log run.log -intstyle", "bits 6\nsplit\n");
  const std::string error =
      "ERROR:DuduzuShell - line 2: split: parameters '' rejected; split takes \"S\" \"-sep S\"\n";
  EXPECT_EQ(run.out, error);
  EXPECT_EQ(ReadFile(work / "run.log"), "> bits 6\nbits set in 6: 2 3\n> split\n" + error);
}

TEST(Commands, FatalEndsOnlyItsCommandUnknownNamesGetASuggestionAndQuitStops) {
  TempDir work;
  ShellRun run = RunShell(work, "", "cat none.txt\nMINT 3 -to 2\nexpnad x\nquit\ngetdef a\n");
  EXPECT_EQ(run.status, 0);
  EXPECT_EQ(run.out,
            "> cat none.txt\n\nCan not Open File : none.txt !\nline 1: cat: return status 5\n"
            "> MINT 3 -to 2\n11\n> expnad x\n"
            "ERROR:DuduzuShell - line 3: unknown command 'expnad' (did you mean 'expand'? "
            "'help' lists the commands)\n> quit\n");
}

TEST(CommandLine, BadOptionOrUnreadableScriptExitsWithStatus1) {
  TempDir work;
  ShellRun bad = RunShell(work, "-bogus"), missing = RunShell(work, "none.cmd");
  EXPECT_EQ(bad.status * 10 + missing.status, 11);
  EXPECT_EQ(bad.err, "usage: duduzu-shell [-log FILE] [-intstyle] [script]\n");
  EXPECT_EQ(missing.err, "duduzu-shell: cannot read none.cmd\n");
  EXPECT_EQ(missing.out, "");
}
