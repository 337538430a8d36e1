// The library of rule sets as hosts meet it: loaded by the factory through its name, with documents that are
// whole and with the same ones broken in every small way.

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <memory>
#include <sstream>
#include <string>
#include <thread>
#include <vector>

#include "tests/plugins/BrokenModel.h"
#include "tests/plugins/RuleSetText.h"
#include "tests/support/ExpectFault.h"
#include "tests/support/XmlMutants.h"

namespace {

using namespace MCKestrel_800;
using kestrel_test::Mutant;
using kestrel_test::XmlMap;
using kestrel_tests::kLoaded;
using kestrel_tests::Outcome;
using kestrel_tests::RecordOf;

constexpr char kRules[] = "tests/data/broken/rules.xml";
const kestrel_tests::Cells kCells = {
    {"age", "20"}, {"income", "2000"}, {"town", "Rome"}, {"rating", "1"}, {"member", "no"}};

std::unique_ptr<ScoreModel> Load(const std::string& document) {
  std::istringstream in(document);
  return std::unique_ptr<ScoreModel>(ModelFactory::MakeModelFromXML(in, {"RuleSetModel"}, std::string()));
}

Outcome LoadAndScore(const std::string& document, const std::string& why) {
  try {
    const std::unique_ptr<ScoreModel> model = Load(document);
    return {kLoaded, kestrel_tests::UseModel(*model, kCells, why)};
  } catch (const KestrelException& fault) {
    return {fault.GetErrorCode(), fault.GetErrorMessage(), fault.GetLine(), fault.GetColumn()};
  }
}

/// Loads every mutant, scores with those that load, and returns how often each code came out.
std::map<int, size_t> TryAll(const std::vector<Mutant>& mutants) {
  std::map<int, size_t> codes;
  for (const Mutant& mutant : mutants) {
    const Outcome outcome = LoadAndScore(mutant.document, mutant.why);
    ++codes[outcome.code];
    if (outcome.code == kLoaded) continue;
    EXPECT_TRUE(outcome.code >= 1 && outcome.code <= 12 && outcome.code != KestrelException::kReserved)
        << mutant.why << ": " << outcome.code;
    EXPECT_FALSE(outcome.text.empty()) << mutant.why;
    if (mutant.document.empty()) continue;
    const auto lines =
        static_cast<unsigned>(1 + std::count(mutant.document.begin(), mutant.document.end(), '\n'));
    EXPECT_TRUE(outcome.line >= 1 && outcome.line <= lines) << mutant.why << ": " << outcome.text;
  }
  return codes;
}

std::string Text() {
  return kestrel_tests::DocumentText(kRules);
}

// 1.5 for high against 2 for low.
TEST(RuleSetLibrary, ScoresBeforeItIsBroken) {
  const Outcome outcome = LoadAndScore(Text(), "whole");
  EXPECT_EQ(outcome.code, kLoaded) << outcome.line << ": " << outcome.text;
  EXPECT_EQ(outcome.text, "low");
}

TEST(RuleSetLibrary, RefusesDocumentsThatAreCutOff) {
  for (const auto& [code, count] : TryAll(kestrel_test::Truncated(Text(), 50)))
    EXPECT_TRUE(code == 4 || code == 6) << code << " came " << count << " times";
}

TEST(RuleSetLibrary, LoadsOrRefusesBrokenAttributes) {
  const std::vector<Mutant> mutants = kestrel_test::WithBrokenAttributes(Text(), 1);
  ASSERT_GT(mutants.size(), 300u);
  const std::map<int, size_t> codes = TryAll(mutants);
  for (const int expected : {kLoaded, 1, 3, 4, 5, 6, 7, 8, 11, 12})
    EXPECT_TRUE(codes.count(expected)) << expected;
}

TEST(RuleSetLibrary, LoadsOrRefusesNumbersInEveryAttribute) {
  const std::string text = Text();
  const XmlMap map(text);
  std::vector<Mutant> mutants;
  for (const XmlMap::Attribute& attribute : map.Attributes()) {
    for (const char* value : {"6", "-1e308", "1,5", "1e999", " 2 ", "0", "-1"}) {
      std::string changed = text;
      changed.replace(attribute.valueStart, attribute.valueEnd - attribute.valueStart, value);
      mutants.push_back(
          {attribute.name + " at byte " + std::to_string(attribute.start) + " set to " + value, changed});
    }
  }
  ASSERT_GT(mutants.size(), 700u);
  const std::map<int, size_t> codes = TryAll(mutants);
  for (const int expected : {kLoaded, 3, 5, 6, 7, 8, 11, 12})
    EXPECT_TRUE(codes.count(expected)) << expected;
}

TEST(RuleSetLibrary, LoadsOrRefusesBrokenElements) {
  const std::vector<Mutant> mutants = kestrel_test::WithBrokenElements(Text(), 1);
  ASSERT_GT(mutants.size(), 150u);
  const std::map<int, size_t> codes = TryAll(mutants);
  for (const int expected : {kLoaded, 1, 4, 6, 8, 12})
    EXPECT_TRUE(codes.count(expected)) << expected;
}

TEST(RuleSetLibrary, LoadsOrRefusesEveryTwoElementsExchanged) {
  const std::string text = Text();
  const XmlMap map(text);
  std::vector<Mutant> mutants;
  for (const XmlMap::Element& first : map.Elements()) {
    for (const XmlMap::Element& second : map.Elements()) {
      if (second.start < first.end) continue;
      mutants.push_back({first.name + " at byte " + std::to_string(first.start) + " exchanged with " +
                             second.name + " at byte " + std::to_string(second.start),
                         text.substr(0, first.start) + text.substr(second.start, second.end - second.start) +
                             text.substr(first.end, second.start - first.end) +
                             text.substr(first.start, first.end - first.start) + text.substr(second.end)});
    }
  }
  ASSERT_GT(mutants.size(), 1000u);
  const std::map<int, size_t> codes = TryAll(mutants);
  EXPECT_TRUE(codes.count(kLoaded));
  EXPECT_TRUE(codes.count(1));
}

TEST(RuleSetLibrary, FaultsPassThroughTheFactory) {
  kestrel_tests::ExpectFault(
      [] { Load(kestrel_tests::Replaced(Text(), "criterion=\"weightedSum\"", "criterion=\"\"")); }, 6,
      "invalid criterion -- ");
}

TEST(RuleSetLibrary, TwoModelsScoreOnTwoThreads) {
  const auto run = [](double limit, int* wrong) {
    const std::unique_ptr<ScoreModel> model = Load(kestrel_tests::RuleSetDocument(
        "weightedSum", "k", "defaultScore='no'",
        kestrel_tests::RuleAbove(std::to_string(limit), "id='r' score='yes'")));
    const std::unique_ptr<ScoreResult> result(model->MakeResult());
    CaseRecord record = RecordOf({{"x", 0.0}});
    for (int i = 0; i < 20000; ++i) {
      record.SetValue(0, static_cast<double>(i));
      const bool is_right = model->Score(&record, result.get()).IsOK() &&
                            result->GetPrediction()->GetString() == (i > limit ? "yes" : "no");
      if (!is_right) ++*wrong;
    }
  };
  int wrong[2] = {};
  std::thread first(run, 5000.0, &wrong[0]);
  std::thread second(run, 15000.0, &wrong[1]);
  first.join();
  second.join();
  EXPECT_EQ(wrong[0], 0);
  EXPECT_EQ(wrong[1], 0);
}

}  // namespace
