// What becomes of a CompoundPredicate: constants that change nothing go, single children stand for the whole.

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/predicates/CompoundPredicate.h"
#include "kestrel/predicates/SimplePredicate.h"
#include "tests/support/PredicateFields.h"
#include "tests/support/PredicateText.h"

namespace {

using kestrel_test::kPredicateFields;
using kestrel_test::ReadIndexedDictionary;
using kestrel_test::ReadPredicate;
using namespace MCKestrel_800;

/// A predicate's shape: "T" and "F" are the constants, a simple predicate is its value, a set is "{}", a
/// compound its operator with its children; "none" is no predicate.
std::string ShapeOf(const ScorePredicate* predicate) {
  if (predicate == nullptr) return "none";
  switch (predicate->GetPredType()) {
    case ScorePredicate::kTrue:
      return "T";
    case ScorePredicate::kFalse:
      return "F";
    case ScorePredicate::kSet:
      return "{}";
    case ScorePredicate::kSimple:
      return static_cast<const SimplePredicate*>(predicate)->GetPredValueByString();
    default:
      break;
  }
  const auto& compound = static_cast<const CompoundPredicate&>(*predicate);
  const char* const names[] = {"or", "and", "xor", "surrogate"};
  std::string shape = std::string(names[compound.GetBoolOperator()]) + "(";
  for (const ScorePredicate* child : compound.GetPredicates())
    shape += (shape.back() == '(' ? "" : " ") + ShapeOf(child);
  return shape + ")";
}

/// The element of a shape written in short: "and[1 T {} or[2 F]]" and "?" for an element of another name.
std::string Written(const std::string& shape) {
  std::string xml, word;
  const auto flush = [&] {
    if (word == "T")
      xml += "<True/>";
    else if (word == "F")
      xml += "<False/>";
    else if (word == "?")
      xml += "<Extension name='a'><True/></Extension>";
    else if (word == "{}")
      xml += "<SimpleSetPredicate field='col' booleanOperator='isIn'><Array>red</Array></SimpleSetPredicate>";
    else if (!word.empty())
      xml += "<SimplePredicate field='num' operator='equal' value='" + word + "'/>";
    word.clear();
  };
  for (const char c : shape) {
    if (c == '[') {
      xml += "<CompoundPredicate booleanOperator='" + word + "'>";
      word.clear();
    } else if (c == ']' || c == ' ') {
      flush();
      if (c == ']') xml += "</CompoundPredicate>";
    } else {
      word += c;
    }
  }
  return xml;
}

struct FoldingRow {
  const char* written;
  const char* read;
};

constexpr FoldingRow kFolding[] = {
    // no child
    {"or[]", "none"},
    {"and[]", "none"},
    {"xor[]", "none"},
    {"surrogate[]", "none"},
    // one child
    {"or[1]", "1"},
    {"and[1]", "1"},
    {"xor[1]", "1"},
    {"surrogate[1]", "1"},
    {"or[{}]", "{}"},
    {"and[{}]", "{}"},
    {"xor[{}]", "{}"},
    {"surrogate[{}]", "{}"},
    {"or[T]", "T"},
    {"or[F]", "F"},
    {"and[T]", "T"},
    {"and[F]", "F"},
    {"xor[T]", "T"},
    {"xor[F]", "F"},
    {"surrogate[T]", "T"},
    {"surrogate[F]", "F"},
    // two children
    {"or[1 2]", "or(1 2)"},
    {"and[1 2]", "and(1 2)"},
    {"xor[1 2]", "xor(1 2)"},
    {"surrogate[1 2]", "surrogate(1 2)"},
    {"or[1 F]", "1"},
    {"or[F 1]", "1"},
    {"or[1 T]", "or(1 T)"},
    {"or[T 1]", "or(T 1)"},
    {"or[F F]", "F"},
    {"or[T T]", "or(T T)"},
    {"or[T F]", "T"},
    {"or[F T]", "T"},
    {"and[1 T]", "1"},
    {"and[T 1]", "1"},
    {"and[1 F]", "and(1 F)"},
    {"and[F 1]", "and(F 1)"},
    {"and[T T]", "T"},
    {"and[F F]", "and(F F)"},
    {"and[T F]", "F"},
    {"and[F T]", "F"},
    {"xor[1 T]", "xor(1 T)"},
    {"xor[1 F]", "xor(1 F)"},
    {"xor[T F]", "xor(T F)"},
    {"xor[F F]", "xor(F F)"},
    {"surrogate[1 T]", "surrogate(1 T)"},
    {"surrogate[F 1]", "surrogate(F 1)"},
    {"surrogate[T F]", "surrogate(T F)"},
    // three children
    {"or[1 2 3]", "or(1 2 3)"},
    {"or[1 F 3]", "or(1 3)"},
    {"or[F F 3]", "3"},
    {"or[1 T F]", "or(1 T)"},
    {"or[F F F]", "F"},
    {"and[1 2 3]", "and(1 2 3)"},
    {"and[T 2 T]", "2"},
    {"and[1 F T]", "and(1 F)"},
    {"and[T T T]", "T"},
    {"xor[1 2 3]", "xor(1 2 3)"},
    {"xor[T F T]", "xor(T F T)"},
    {"surrogate[1 2 T]", "surrogate(1 2 T)"},
    {"surrogate[1 {} F]", "surrogate(1 {} F)"},
    // other elements
    {"and[?]", "none"},
    {"and[? 1 ?]", "1"},
    {"or[? F]", "F"},
    {"xor[1 ? 2]", "xor(1 2)"},
    // compounds inside
    {"and[or[1 2] 3]", "and(or(1 2) 3)"},
    {"and[or[1] 2]", "and(1 2)"},
    {"and[or[1 F] T]", "1"},
    {"and[or[] 1]", "1"},
    {"and[or[] and[]]", "none"},
    {"or[and[T] 1]", "or(T 1)"},
    {"or[or[F] 1]", "or(F 1)"},
    {"and[xor[] T]", "T"},
    {"and[and[T] 1]", "and(T 1)"},
    {"surrogate[and[1 2] or[3 4] T]", "surrogate(and(1 2) or(3 4) T)"},
    {"xor[xor[xor[1 2] 3] 4]", "xor(xor(xor(1 2) 3) 4)"},
    {"or[and[surrogate[xor[1]]]]", "1"},
};

TEST(CompoundPredicateReader, DropsWhatChangesNothing) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (const FoldingRow& row : kFolding) {
    const auto predicate = ReadPredicate(Written(row.written), *dictionary);
    EXPECT_EQ(ShapeOf(predicate.get()), row.read) << row.written;
  }
}

TEST(CompoundPredicateReader, PassesOrdinalAsScaleAndTheDerivedDictionaryOn) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  BaseDictionary derived;
  derived.AddVar("made", new DictVar("made", ScoreDictVar::kNUMERIC_VAR));
  const auto predicate = ReadPredicate(
      "<CompoundPredicate booleanOperator='or'><CompoundPredicate booleanOperator='and'>"
      "<SimplePredicate field='rank' operator='lessThan' value='12.5'/>"
      "<SimplePredicate field='made' operator='equal' value='1'/></CompoundPredicate>"
      "<SimplePredicate field='rank' operator='equal' value='30'/></CompoundPredicate>",
      *dictionary, true, &derived);
  CaseRecord record;
  record.Add("rank", new NumericValue(12.0));
  record.Add("made", new NumericValue(1.0));
  EXPECT_EQ(predicate->Evaluate(&record, nullptr), ScorePredicate::PredTrue);
  record.SetValue("rank", 13.0);
  EXPECT_EQ(predicate->Evaluate(&record, nullptr), ScorePredicate::PredFalse);
}

struct EvaluationRow {
  const char* written;
  const char* probes;  ///< of the field "num"
};

// The rules are the classes' own; here they meet what the reader makes.
constexpr EvaluationRow kEvaluations[] = {
    {"or[1 2]", "1:T 2:T 3:F -:U"},
    {"and[1 T]", "1:T 2:F -:U"},
    {"and[1 F]", "1:F 2:F -:F"},
    {"or[1 T]", "1:T 2:T -:T"},
    {"xor[1 T]", "1:F 2:T -:U"},
    {"surrogate[1 T]", "1:T 2:F -:S"},
    {"surrogate[1 F]", "1:T 2:F -:F"},
    {"or[surrogate[1 T] 2]", "1:T 2:T 3:F -:U"},
    {"and[xor[1 T] or[2 3]]", "1:F 2:T -:U"},
};

TEST(CompoundPredicateReader, GivesPredicatesThatDecide) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (const EvaluationRow& row : kEvaluations) {
    const auto predicate = ReadPredicate(Written(row.written), *dictionary);
    EXPECT_EQ(kestrel_test::Answers(*predicate, *dictionary, "num", row.probes), row.probes) << row.written;
  }
}

TEST(CompoundPredicateReader, ReadsManyChildren) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  std::string shape = "or[";
  for (int i = 0; i < 5000; ++i)
    shape += std::to_string(i) + " ";
  const auto predicate = ReadPredicate(Written(shape + "F]"), *dictionary);
  EXPECT_EQ(static_cast<const CompoundPredicate&>(*predicate).GetCount(), 5000);
  EXPECT_EQ(kestrel_test::Answers(*predicate, *dictionary, "num", "4999:T 5000:F"), "4999:T 5000:F");
}

}  // namespace
