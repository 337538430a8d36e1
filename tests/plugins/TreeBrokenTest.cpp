// Documents of trees broken in every small way, from bytes to a scored case: loading one gives a model that
// scores, or a KestrelException with a code, a text and the place, never anything else.

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <string>
#include <vector>

#include "tests/plugins/TreeBroken.h"
#include "tests/support/XmlMutants.h"

namespace kestrel_tests {
namespace {

using kestrel_test::Mutant;
using kestrel_test::XmlMap;
using MCKestrel_800::KestrelException;

/// Loads every mutant and scores with those that load; returns how often each code came out.
std::map<int, size_t> TryAll(const std::vector<Mutant>& mutants) {
  std::map<int, size_t> codes;
  for (const Mutant& mutant : mutants) {
    const Outcome outcome = LoadTree(mutant.document, mutant.why);
    ++codes[outcome.code];
    if (outcome.code == kLoaded) continue;
    EXPECT_TRUE(outcome.code >= 1 && outcome.code <= 12 && outcome.code != KestrelException::kReserved)
        << mutant.why << ": " << outcome.code << ' ' << outcome.text;
    EXPECT_FALSE(outcome.text.empty()) << mutant.why;
    if (mutant.document.empty()) continue;
    const auto lines =
        static_cast<unsigned>(1 + std::count(mutant.document.begin(), mutant.document.end(), '\n'));
    EXPECT_TRUE(outcome.line >= 1 && outcome.line <= lines) << mutant.why << ": line " << outcome.line;
    EXPECT_GE(outcome.column, 1u) << mutant.why;
  }
  return codes;
}

void ExpectCodes(const std::map<int, size_t>& codes, const std::vector<int>& expected) {
  for (const int code : expected)
    EXPECT_TRUE(codes.count(code)) << code;
}

/// The document with each of the strategies for missing values, complete for it.
std::vector<std::string> Documents() {
  const std::string given = "missingValueStrategy=\"defaultChild\"";
  std::vector<std::string> documents = {TreeText()};
  for (const char* strategy : {"none", "weightedConfidence", "aggregateNodes"}) {
    std::string document =
        Replaced(TreeText(), given, std::string("missingValueStrategy=\"") + strategy + "\"");
    for (const char* predicate : {"operator=\"notEqual\" value=\"Rome\"/>", "value=\"10000\"/>",
                                  "operator=\"isNotMissing\"/>", "operator=\"isMissing\"/>", "<False/>"}) {
      document = Replaced(document, predicate,
                          std::string(predicate) +
                              "<ScoreDistribution value=\"low\" recordCount=\"3\"/>"
                              "<ScoreDistribution value=\"high\" recordCount=\"1\"/>");
    }
    documents.push_back(
        Replaced(document, "<Node id=\"poor\"", "<Node id=\"poor\" score=\"high\" recordCount=\"70\""));
  }
  return documents;
}

TEST(TreeBroken, ScoresBeforeItIsBroken) {
  for (const std::string& document : Documents()) {
    const Outcome outcome = LoadTree(document, "whole");
    EXPECT_EQ(outcome.code, kLoaded) << outcome.line << ": " << outcome.text;
    EXPECT_EQ(outcome.text, "low");
  }
}

TEST(TreeBroken, CutOffIsNoDocument) {
  const std::vector<Mutant> mutants = kestrel_test::Truncated(TreeText(), 50);
  ASSERT_GT(mutants.size(), 70u);
  for (const auto& [code, count] : TryAll(mutants))
    EXPECT_TRUE(code == 4 || code == 6) << code << " came " << count << " times";
}

TEST(TreeBroken, BrokenAttributesLoadOrAreRefused) {
  for (const std::string& document : Documents()) {
    const std::vector<Mutant> mutants = kestrel_test::WithBrokenAttributes(document, 1);
    ASSERT_GT(mutants.size(), 300u);
    ExpectCodes(TryAll(mutants), {kLoaded, 1, 3, 4, 5, 6, 7, 8, 11, 12});
  }
}

TEST(TreeBroken, NumbersInEveryAttributeLoadOrAreRefused) {
  for (const std::string& document : Documents()) {
    const XmlMap map(document);
    std::vector<Mutant> mutants;
    for (const XmlMap::Attribute& attribute : map.Attributes()) {
      for (const char* value : {"6", "1e308", "-1e308", "1,5", "1e999", " 2 ", "0", "1e-320"}) {
        std::string changed = document;
        changed.replace(attribute.valueStart, attribute.valueEnd - attribute.valueStart, value);
        mutants.push_back(
            {attribute.name + " at byte " + std::to_string(attribute.start) + " set to " + value, changed});
      }
    }
    ASSERT_GT(mutants.size(), 900u);
    ExpectCodes(TryAll(mutants), {kLoaded, 3, 5, 6, 7, 8, 11, 12});
  }
}

TEST(TreeBroken, BrokenElementsLoadOrAreRefused) {
  for (const std::string& document : Documents()) {
    const std::vector<Mutant> mutants = kestrel_test::WithBrokenElements(document, 1);
    ASSERT_GT(mutants.size(), 200u);
    ExpectCodes(TryAll(mutants), {kLoaded, 1, 3, 4, 6, 7, 8, 12});
  }
}

TEST(TreeBroken, TwoElementsExchangedLoadOrAreRefused) {
  const std::string text = TreeText();
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
  ASSERT_GT(mutants.size(), 1500u);
  ExpectCodes(TryAll(mutants), {kLoaded, 1, 4, 6, 12});
}

}  // namespace
}  // namespace kestrel_tests
