#include "apps/kestrel/CommandLine.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <map>
#include <memory>
#include <sstream>

#include "apps/kestrel/CheckCommand.h"
#include "apps/kestrel/CopyCommand.h"
#include "apps/kestrel/DeriveCommand.h"
#include "apps/kestrel/DescribeCommand.h"
#include "apps/kestrel/OutputFile.h"
#include "apps/kestrel/ProgramError.h"
#include "apps/kestrel/ScoreCommand.h"
#include "apps/kestrel/ShownText.h"

namespace kestrel_program {
namespace {

constexpr const char* kVersionText = "kestrel " KESTREL_VERSION;

constexpr const char* kTableHelp =
    "The table has a line with the columns' names first; cells are separated by commas, tabs, semicolons or "
    "vertical\n"
    "bars. Columns may stand in any order, those that are not read are ignored. A cell in quotation marks\n"
    "may hold separators, line ends and quotation marks written twice; blanks around a cell do not count "
    "unless they\n"
    "are in quotation marks. Numbers have a decimal point (not inf or nan), dates and times are written as\n"
    "2024-02-29, 13:05:59 and 2024-02-29T13:05:59. All text is UTF-8.\n"
    "\n";

constexpr const char* kScoreHelp =
    "The output has the columns that are kept, then the output fields that the model's document declares, in "
    "its\n"
    "order. Without any, and behind them with --all, there are\n"
    "  prediction              the predicted number or category\n"
    "  probability             of the predicted category (classifications)\n"
    "  probability_<category>  of each category that the target lists, in its order (classifications)\n"
    "and with --explain, behind all others,\n"
    "  explanation             the nodes that the case passed, or the rules that fired\n"
    "A case without prediction has empty cells (null in jsonl), but is explained as far as it came, and its "
    "output\n"
    "fields tell what they have to tell. A name that another column has already gets \"_2\" behind it. A "
    "file that is\n"
    "written appears when it is complete, not before.\n";

constexpr const char* kDeriveHelp =
    "The output has the columns that are kept, then one for each derived field, named like it. A missing "
    "value is an\n"
    "empty cell (null in jsonl). A name that a kept column has already gets \"_2\" behind it. A file that is "
    "written\n"
    "appears when it is complete, not before. Derived fields in a model's LocalTransformations are not "
    "read.\n";

/// Shows an option that may have a value behind "=" as such; the parser's own way shows its stand-in for no
/// value.
class HelpFormatter : public CLI::Formatter {
 public:
  std::string make_option_name(const CLI::Option* option, bool is_positional) const override {
    return option->check_name("--keep") ? "--keep[=NAME,...]"
                                        : CLI::Formatter::make_option_name(option, is_positional);
  }
};

/// What the options of all commands are read into.
struct Values {
  std::string model;
  std::string names_file;
  std::string data = "-";
  std::string output = "-";
  std::string delimiter;
  std::string format = "csv";
  std::string on_error = "stop";
  std::vector<std::string> keep;
  std::vector<std::string> missing;
  std::vector<std::string> fields;
  bool shows_all = false;
  bool explains = false;
  bool shows_statistics = false;
  bool as_json = false;
};

/// Stands for every column; no table has such a name by chance.
constexpr const char* kAllColumns = "*";

const std::map<std::string, char>& DelimiterNames() {
  static const std::map<std::string, char> names = {{"comma", ','}, {"tab", '\t'}, {"semicolon", ';'},
                                                    {"pipe", '|'},  {",", ','},    {"\t", '\t'},
                                                    {"\\t", '\t'},  {";", ';'},    {"|", '|'}};
  return names;
}

char DelimiterOf(const Values& values) {
  if (values.delimiter.empty()) return 0;
  const auto found = DelimiterNames().find(values.delimiter);
  if (found != DelimiterNames().end()) return found->second;
  throw ProgramError(kUsage, "--delimiter: \"" + values.delimiter +
                                 "\" is none of comma, tab, semicolon, pipe or the character itself");
}

TableWriter::Format FormatOf(const Values& values) {
  return values.format == "jsonl" ? TableWriter::Format::kJsonLines : TableWriter::Format::kCsv;
}

void AddDocument(CLI::App& command, Values& values, const char* text) {
  command.add_option("MODEL", values.model, text)->required()->type_name("FILE");
}

void AddModel(CLI::App& command, Values& values) {
  AddDocument(command, values, "The model's document; - for the standard input");
  command
      .add_option("--models", values.names_file,
                  "A file with the model elements to look for, instead of all that PMML has")
      ->type_name("FILE");
}

void AddTable(CLI::App& command, Values& values) {
  command.add_option("DATA", values.data, "The table; - or nothing for the standard input")
      ->type_name("FILE");
  command.add_option("-o,--output", values.output, "The file to write; - or nothing for the standard output")
      ->type_name("FILE");
  command
      .add_option(
          "--delimiter", values.delimiter,
          "What separates the table's cells: comma, tab, semicolon, pipe or the character itself; found "
          "out from the first line when not given")
      ->type_name("NAME");
  command
      .add_option("--format", values.format,
                  "The output: csv (with commas, the default) or jsonl (an object a line)")
      ->check(CLI::IsMember({"csv", "jsonl"}))
      ->type_name("FORMAT");
}

/// What is done with the cases of a table.
/// added  what stands beside the kept columns: "predictions"
void AddCases(CLI::App& command, Values& values, const std::string& added) {
  command.add_flag(
      "--keep{*}", values.keep,
      "Copy the table's columns beside the " + added + ": all with --keep, some with --keep=NAME,NAME");
  command
      .add_option(
          "--missing", values.missing,
          "Texts that stand for a missing value beside the empty cell, with commas between them: NA,?")
      ->delimiter(',')
      ->allow_extra_args(false)
      ->type_name("TEXT");
  command
      .add_option("--on-error", values.on_error,
                  "A case that cannot be read or scored: stop (the default) there, or null: leave its " +
                      added + " empty and go on")
      ->check(CLI::IsMember({"stop", "null"}))
      ->type_name("WHAT");
  command.add_flag("--stats", values.shows_statistics,
                   "Tell in the end how many cases there were and how fast it went");
}

void AddScore(CLI::App& program, Values& values) {
  CLI::App& command = *program.add_subcommand("score", "Score the cases of a table");
  AddModel(command, values);
  AddTable(command, values);
  AddCases(command, values, "predictions");
  command.add_flag("--all", values.shows_all,
                   "Write the prediction and its probabilities also where the model has output fields");
  command.add_flag("--explain", values.explains,
                   "Tell which nodes of a tree, or rules of a rule set, led to each prediction");
  command.footer(std::string(kTableHelp) + kScoreHelp + "\n" + kExitCodesHelp);
}

void AddDerive(CLI::App& program, Values& values) {
  CLI::App& command = *program.add_subcommand(
      "derive", "Compute a document's derived fields for the cases of a table, without a model");
  AddDocument(command, values, "The document with the derived fields; - for the standard input");
  AddTable(command, values);
  AddCases(command, values, "derived fields");
  command
      .add_option("--fields", values.fields,
                  "The derived fields to compute, with commas between them, instead of all")
      ->allow_extra_args(false)
      ->type_name("NAME,...");
  command.footer(std::string(kTableHelp) + kDeriveHelp + "\n" + kExitCodesHelp);
}

void AddDescribe(CLI::App& program, Values& values) {
  CLI::App& command = *program.add_subcommand("describe", "Show what a model is and what it reads");
  AddModel(command, values);
  command.add_flag("--json", values.as_json, "Write one JSON object instead of a table");
}

void AddCheck(CLI::App& program, Values& values) {
  CLI::App& command =
      *program.add_subcommand("check", "Tell whether a document is good, or what is wrong and where");
  AddModel(command, values);
}

void AddCopy(CLI::App& program, Values& values) {
  CLI::App& command = *program.add_subcommand(
      "copy-table", "Read a table and write it again, without a model (to measure against)");
  AddTable(command, values);
}

bool HasCommand(const CLI::App& program, const std::string& name) {
  for (const CLI::App* command : program.get_subcommands([](const CLI::App*) { return true; })) {
    if (command->get_name() == name) return true;
  }
  return false;
}

/// What is wrong with the command line and what would be right.
std::string ExplainUsage(const CLI::App& program, const std::vector<std::string>& arguments,
                         const CLI::ParseError& fault) {
  if (arguments.empty() || !HasCommand(program, arguments[0])) {
    return (arguments.empty() ? std::string("a command is missing")
                              : "\"" + ShownText(arguments[0]) + "\" is no command") +
           "; accepted is score, derive, describe, check or copy-table\n  hint: kestrel --help tells what "
           "they do";
  }
  const auto keep = std::find(arguments.begin(), arguments.end(), "--keep");
  if (dynamic_cast<const CLI::ExtrasError*>(&fault) != nullptr && arguments.end() - keep > 1 &&
      keep[1][0] != '-') {
    return std::string(fault.what()) +
           "\n  hint: the names of columns stand behind an equals sign: --keep=" + ShownText(keep[1]);
  }
  return std::string(fault.what()) + "\n  hint: kestrel " + arguments[0] + " --help lists what is accepted";
}

TableOptions TableOf(const Values& values) {
  TableOptions table;
  table.document = values.model;
  table.data = values.data;
  table.output = values.output;
  table.delimiter = DelimiterOf(values);
  table.keep_all = std::count(values.keep.begin(), values.keep.end(), kAllColumns) > 0;
  table.keep = values.keep;
  table.missing = values.missing;
  table.goes_on_after_faults = values.on_error == "null";
  table.format = FormatOf(values);
  table.shows_statistics = values.shows_statistics;
  return table;
}

ExitCode Run(const CLI::App& program, const Values& values) {
  if (program.got_subcommand("score")) {
    return Score({TableOf(values), values.names_file, values.shows_all, values.explains});
  }
  if (program.got_subcommand("derive")) return Derive({TableOf(values), values.fields});
  if (program.got_subcommand("describe")) return Describe(values.model, values.names_file, values.as_json);
  if (program.got_subcommand("check")) return Check(values.model, values.names_file);
  CopyOptions options;
  options.data = values.data;
  options.output = values.output;
  options.delimiter = DelimiterOf(values);
  options.format = FormatOf(values);
  return CopyTable(options);
}

}  // namespace

ExitCode RunCommandLine(const std::vector<std::string>& arguments) {
  Values values;
  CLI::App program("Scores predictive models and computes derived fields (PMML documents).", "kestrel");
  // A word that begins with a slash is a path on Windows too.
  program.allow_windows_style_options(false);
  program.formatter(std::make_shared<HelpFormatter>());
  AddScore(program, values);
  AddDerive(program, values);
  AddDescribe(program, values);
  AddCheck(program, values);
  AddCopy(program, values);
  program.require_subcommand(1);
  program.set_version_flag("--version", kVersionText, "Show the version");
  program.set_help_flag("-h,--help", "Show this help");
  program.footer(std::string("\"kestrel COMMAND --help\" tells more about a command.\n\n") + kExitCodesHelp);
  for (CLI::App* command : program.get_subcommands({})) {
    command->set_version_flag("--version", kVersionText, "Show the version");
    command->set_help_flag("-h,--help", "Show this help");
    if (command->get_footer().empty()) command->footer(kExitCodesHelp);
  }
  try {
    // The last one goes first: that is how the parser takes them.
    program.parse(std::vector<std::string>(arguments.rbegin(), arguments.rend()));
  } catch (const CLI::Success& wanted) {
    std::ostringstream text;
    program.exit(wanted, text, text);
    OutputFile output("-");
    output.GetBuffer() += text.str();
    output.Finish();
    return kDone;
  } catch (const CLI::ParseError& fault) {
    throw ProgramError(kUsage, ExplainUsage(program, arguments, fault));
  }
  return Run(program, values);
}

}  // namespace kestrel_program
