// Help, versions and command lines that are not right.

#include <gtest/gtest.h>

#include "tests/apps/KestrelProgram.h"

namespace kestrel_tests {
namespace {

using Arguments = std::vector<std::string>;

TEST(KestrelCommandLine, HasHelpEverywhereWithTheExitCodes) {
  const Arguments rows[] = {
      {"--help"},          {"-h"},          {"score", "--help"},      {"describe", "--help"},
      {"check", "--help"}, {"score", "-h"}, {"copy-table", "--help"}, {"derive", "--help"}};
  for (const Arguments& arguments : rows) {
    const ProgramOutcome outcome = RunKestrel(arguments);
    EXPECT_EQ(outcome.exit_code, 0) << arguments[0];
    EXPECT_EQ(outcome.errors, "") << arguments[0];
    EXPECT_NE(
        outcome.output.find("Exit codes:\n"
                            "  0  done\n"
                            "  1  done, but some cases have no answer because they could not be read or "
                            "scored\n"
                            "  2  the command line is not right\n"
                            "  3  the model's document cannot be used\n"
                            "  4  the table cannot be used\n"
                            "  5  a file or stream could not be read or written, or the memory did not "
                            "suffice\n"),
        std::string::npos)
        << outcome.output;
    EXPECT_NE(outcome.output.find("Usage: kestrel"), std::string::npos) << outcome.output;
  }
}

TEST(KestrelCommandLine, HelpOfScoreTellsOfEveryOption) {
  const std::string help = RunKestrel({"score", "--help"}).output;
  for (const char* word :
       {"MODEL", "DATA", "-o,--output", "--models", "--delimiter", "--format", "{csv,jsonl}",
        "--keep[=NAME,...]", "--missing", "--on-error", "{stop,null}", "--all", "--explain", "--stats",
        "--version", "probability_<category>", "explanation"}) {
    EXPECT_NE(help.find(word), std::string::npos) << word;
  }
}

TEST(KestrelCommandLine, HelpOfDeriveTellsOfEveryOption) {
  const std::string help = RunKestrel({"derive", "--help"}).output;
  for (const char* word : {"MODEL", "DATA", "-o,--output", "--delimiter", "--format", "{csv,jsonl}",
                           "--keep[=NAME,...]", "--missing", "--on-error", "{stop,null}", "--fields",
                           "--stats", "--version", "LocalTransformations"}) {
    EXPECT_NE(help.find(word), std::string::npos) << word;
  }
  EXPECT_EQ(help.find("--models"), std::string::npos);
  EXPECT_EQ(help.find("--explain"), std::string::npos);
}

TEST(KestrelCommandLine, HasTheVersionEverywhere) {
  for (const Arguments& arguments :
       {Arguments{"--version"}, Arguments{"score", "--version"}, Arguments{"describe", "--version"},
        Arguments{"check", "--version"}, Arguments{"derive", "--version"},
        Arguments{"copy-table", "--version"}}) {
    const ProgramOutcome outcome = RunKestrel(arguments);
    EXPECT_EQ(outcome.exit_code, 0);
    EXPECT_EQ(outcome.output, "kestrel 8.0.0\n");
    EXPECT_EQ(outcome.errors, "");
  }
}

struct UsageRow {
  Arguments arguments;
  const char* want;
  const char* hint;
};

const char kCommands[] = "kestrel --help tells what they do";
const char kScore[] = "kestrel score --help lists what is accepted";

const UsageRow kUsageRows[] = {
    {{}, "a command is missing; accepted is score, derive, describe, check or copy-table", kCommands},
    {{"scare"},
     "\"scare\" is no command; accepted is score, derive, describe, check or copy-table",
     kCommands},
    {{"--fast"},
     "\"--fast\" is no command; accepted is score, derive, describe, check or copy-table",
     kCommands},
    {{"score"}, "MODEL is required", kScore},
    {{"derive"}, "MODEL is required", "kestrel derive --help lists what is accepted"},
    {{"derive", "m", "--fields"},
     "--fields: 1 required NAME,... missing",
     "kestrel derive --help lists what is accepted"},
    {{"derive", "m", "--explain"},
     "The following argument was not expected: --explain",
     "kestrel derive --help lists what is accepted"},
    {{"describe"}, "MODEL is required", "kestrel describe --help lists what is accepted"},
    {{"check"}, "MODEL is required", "kestrel check --help lists what is accepted"},
    {{"score", "m", "d", "e"}, "The following argument was not expected: e", kScore},
    {{"score", "m", "--frobnicate"}, "The following argument was not expected: --frobnicate", kScore},
    {{"score", "m", "--format", "xml"}, "--format: xml not in {csv,jsonl}", kScore},
    {{"score", "m", "--on-error", "panic"}, "--on-error: panic not in {stop,null}", kScore},
    {{"score", "m", "-o"}, "--output: 1 required FILE missing", kScore},
    {{"score", "m", "d", "--keep", "id"},
     "The following argument was not expected: id",
     "the names of columns stand behind an equals sign: --keep=id"},
    {{"score", "m", "d", "e", "--keep", "--stats"}, "The following argument was not expected: e", kScore},
    {{"check", "m", "--json"},
     "The following argument was not expected: --json",
     "kestrel check --help lists what is accepted"},
};

TEST(KestrelCommandLine, SaysWhatIsNotRight) {
  for (const UsageRow& row : kUsageRows) {
    const ProgramOutcome outcome = RunKestrel(row.arguments);
    EXPECT_EQ(outcome.exit_code, 2) << row.want;
    EXPECT_EQ(outcome.output, "") << row.want;
    EXPECT_EQ(outcome.errors, "kestrel: " + std::string(row.want) + "\n  hint: " + row.hint + "\n");
  }
  const ProgramOutcome outcome = RunKestrel({"score", "m", "--delimiter", "x"});
  EXPECT_EQ(outcome.exit_code, 2);
  EXPECT_EQ(outcome.errors,
            "kestrel: --delimiter: \"x\" is none of comma, tab, semicolon, pipe or the character itself\n");
}

}  // namespace
}  // namespace kestrel_tests
